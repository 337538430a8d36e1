#include "plugins/regression/RegressionTranslator.h"

#include <xercesc/dom/DOMElement.hpp>

#include <utility>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"
#include "plugins/regression/RegressionModel.h"
#include "plugins/regression/RegressionTableReader.h"

namespace MCKestrel_800 {
namespace {

using xercesc::DOMElement;
using Tags = PMMLTagText;

Normalization ReadNormalization(const DOMElement* element) {
  Normalization method = Normalization::kNone;
  const XMLCh* text = FindAttribute(element, Tags::XML_ATT_NORMMATHOD);
  if (text != nullptr && !FindNormalization(Narrow(text), method)) {
    FailAt(element, KestrelException::kInvalidDocument, "invalid normalizationMethod -- " + Narrow(text));
  }
  return method;
}

std::vector<RegressionTable> ReadTables(const DOMElement* element, const RegressionTableReader& reader,
                                        bool is_classification) {
  std::vector<RegressionTable> tables;
  for (const DOMElement* child : ChildElements(element, Tags::XML_ELE_REGTABLE)) {
    if (!is_classification && !tables.empty()) {
      FailAt(child, KestrelException::kStructure, "Only one RegressionTable is allowed for regression!");
    }
    tables.push_back(reader.Read(child, is_classification));
  }
  if (tables.empty()) {
    FailAt(element, KestrelException::kMissingElement, "Node is missing --- RegressionTable ---");
  }
  return tables;
}

}  // namespace

RegressionTranslator::RegressionTranslator() : ModelTranslator(PMMLModelTags::XML_ELE_REGMODEL) {}

std::unique_ptr<ScoreModel> RegressionTranslator::BuildModel(DOMElement* element,
                                                             ModelDictionaries dictionaries) {
  ModelFrame frame = ReadFrame(element, dictionaries);
  RegressionModel::Definition definition;
  definition.normalization = ReadNormalization(element);
  definition.tables = ReadTables(element, RegressionTableReader(frame.schema, frame.target_variable),
                                 frame.is_classification);
  try {
    return std::make_unique<RegressionModel>(std::move(dictionaries), std::move(frame),
                                             std::move(definition));
  } catch (const KestrelException& fault) {
    FailAt(element, static_cast<KestrelException::ExceptionCode>(fault.GetErrorCode()),
           fault.GetErrorMessage());
  }
}

}  // namespace MCKestrel_800
