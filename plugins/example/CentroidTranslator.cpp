#include <CentroidModel.h>
#include <CentroidTranslator.h>

#include <algorithm>
#include <set>

#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"
#include "plugins/support/Attributes.h"
#include "plugins/support/TargetCategories.h"

using namespace MCKestrel_800;
using xercesc::DOMElement;
namespace centroid {
namespace {

std::map<std::string, double> ReadCoordinates(DOMElement* centroid, const MiningSchema& schema) {
  BaseTranslator::GetChildByTagForced(centroid, "Coordinate");
  std::map<std::string, double> coordinates;
  for (const DOMElement* element : ChildElements(centroid, u"Coordinate")) {
    const std::string name = AttributeText(element, u"field");
    const MiningField* field = schema.FindInput(name);
    if (field == nullptr) {
      FailAt(element, KestrelException::kUnknownVariable,
             "Variable " + name + " not among the active fields of the MiningSchema!");
    }
    if (field->variable->GetVarType() == ScoreDictVar::STRING_VAR) {
      FailOnField(element, KestrelException::kInvalidType, name, ": Invalid Variable Type");
    }
    if (!coordinates.emplace(name, ReadNumber(element, u"value")).second) {
      FailOnField(element, KestrelException::kStructure, name, ": Duplicated Coordinate!");
    }
  }
  return coordinates;
}

std::vector<Centroid> ReadCentroids(DOMElement* model, const ModelFrame& frame) {
  TargetCategories categories(frame.target_variable);
  std::set<int> seen;
  std::vector<Centroid> centroids;
  BaseTranslator::GetChildByTagForced(model, "Centroid");
  for (DOMElement* element : ChildElements(model, u"Centroid")) {
    const std::string text = Narrow(BaseTranslator::GetAttributeForced(element, "category"));
    const int category = categories.Find(element, text);
    if (!seen.insert(category).second) {
      FailAt(element, KestrelException::kStructure, "\"" + text + "\": Duplicated Category Value!");
    }
    std::unique_ptr<ScoreValue> value(categories.Get(category).Clone());
    centroids.push_back({std::move(value), ReadCoordinates(element, frame.schema)});
    const auto& first = centroids.front().coordinates;
    const auto& last = centroids.back().coordinates;
    if (!std::equal(first.begin(), first.end(), last.begin(), last.end(),
                    [](const auto& left, const auto& right) { return left.first == right.first; })) {
      FailAt(element, KestrelException::kStructure, "Centroids have different fields!");
    }
  }
  return centroids;
}

}  // namespace

std::unique_ptr<ScoreModel> CentroidTranslator::BuildModel(DOMElement* element,
                                                           ModelDictionaries dictionaries) {
  ModelFrame frame = ReadFrame(element, dictionaries);
  if (!frame.is_classification) {
    FailAt(element, KestrelException::kUnsupported, "functionName -- regression: Not supported!");
  }
  std::vector<Centroid> centroids = ReadCentroids(element, frame);
  return std::make_unique<CentroidModel>(std::move(dictionaries), std::move(frame), std::move(centroids));
}

}  // namespace centroid
