// Reads derived fields from text, the way a plug-in does, over a data dictionary with a field of every kind.

#ifndef KESTREL_TESTS_SUPPORT_DERIVEDTEXT_H
#define KESTREL_TESTS_SUPPORT_DERIVEDTEXT_H

#include <memory>
#include <string>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/transform/TransformationDictionary.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "tests/support/DictionaryText.h"

namespace kestrel_test {

/// Fields that derived fields are read over: numbers x and y (99 missing in x), dates, and categories with
/// and without lists.
constexpr char kDerivedSources[] =
    "<DataDictionary numberOfFields='10'>"
    "<DataField name='x' optype='continuous' dataType='double'>"
    "<Value value='99' property='missing'/></DataField>"
    "<DataField name='y' optype='continuous' dataType='integer'/>"
    "<DataField name='day' optype='continuous' dataType='dateDaysSince[1970]'/>"
    "<DataField name='born' optype='continuous' dataType='date'/>"
    "<DataField name='clock' optype='continuous' dataType='timeSeconds'/>"
    "<DataField name='color' optype='categorical' dataType='string'>"
    "<Value value='red'/><Value value='green'/><Value value='blue'/></DataField>"
    "<DataField name='free' optype='categorical' dataType='string'/>"
    "<DataField name='code' optype='categorical' dataType='integer'>"
    "<Value value='1'/><Value value='2'/></DataField>"
    "<DataField name='size' optype='ordinal' dataType='string'>"
    "<Value value='low'/><Value value='mid'/><Value value='high'/></DataField>"
    "<DataField name='epoch' optype='ordinal' dataType='dateDaysSince[1970]'>"
    "<Value value='100'/><Value value='200'/></DataField>"
    "</DataDictionary>";

/// Derived fields with the data dictionary that they refer to.
struct DerivedFields {
  std::unique_ptr<MCKestrel_800::ScoreDictionary> data;
  std::unique_ptr<MCKestrel_800::TransformationDictionary> derived;

  /// A derived field by its name; null when there is none.
  const MCKestrel_800::TransformVar* Get(const std::string& name) const {
    return dynamic_cast<const MCKestrel_800::TransformVar*>(derived->GetVar(name));
  }
};

/// Reads a document whose root holds the derived fields, whatever its tag.
inline DerivedFields ReadDerivedDocument(const std::string& xml,
                                         const std::string& sources = kDerivedSources) {
  DerivedFields fields;
  fields.data = ReadDictionary(sources);
  const auto tree = ReadTree(xml);
  fields.derived.reset(MCKestrel_800::PMMLTranslator::HandleTransformationDictionary(
      tree->GetRoot(), fields.data.get(), nullptr));
  return fields;
}

/// The text of a document of derived fields, and of one field, "d", with its attributes and expression.
inline std::string DerivedDocument(const std::string& fields) {
  return "<TransformationDictionary>" + fields + "</TransformationDictionary>";
}
inline std::string DerivedField(const std::string& type, const std::string& content) {
  return "<DerivedField name='d' " + type + ">" + content + "</DerivedField>";
}

constexpr char kNumber[] = "optype='continuous' dataType='double'";
constexpr char kCategory[] = "optype='categorical' dataType='string'";
constexpr char kNumberCategory[] = "optype='categorical' dataType='integer'";

/// One derived field, "d".
inline DerivedFields ReadDerivedField(const std::string& type, const std::string& content) {
  return ReadDerivedDocument(DerivedDocument(DerivedField(type, content)));
}

}  // namespace kestrel_test

#endif  // KESTREL_TESTS_SUPPORT_DERIVEDTEXT_H
