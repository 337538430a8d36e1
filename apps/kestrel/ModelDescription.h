// What a model is and what it reads, in words.

#ifndef KESTREL_APPS_KESTREL_MODELDESCRIPTION_H
#define KESTREL_APPS_KESTREL_MODELDESCRIPTION_H

#include <string>
#include <vector>

namespace MCKestrel_800 {
class ScoreDictionary;
class ScoreModel;
class TransformationDictionary;
}  // namespace MCKestrel_800

namespace kestrel_program {

class ExpressionText;

/// One variable of the model.
struct FieldDescription {
  struct Category {
    std::string value;
    std::string label;  ///< empty when it is the value's own text
  };

  std::string name;
  std::string label;
  std::string type;   ///< "number", "integer", "text", or the name of the date or time type
  std::string level;  ///< "continuous", "ordinal" or "nominal"
  std::string
      role;  ///< "predictor", "target", "supplementary", "order", "group", ...; empty for derived fields
  bool is_read = false;  ///< whether the table must have a column for it
  std::vector<Category> categories;
  std::vector<std::string> missing;  ///< single values ("-99") and intervals ("[900, 999)")
  std::string expression;            ///< of derived fields
};

/// One output field of the model.
struct OutputDescription {
  std::string name;
  std::string label;
  std::string type;     ///< as of a FieldDescription
  std::string feature;  ///< what it tells, by its name in documents; empty for a field that tells nothing
  std::string value;    ///< the category that a probability or residual is about; empty for the predicted one
};

struct ModelDescription {
  ModelDescription(const MCKestrel_800::ScoreModel& model, const ExpressionText& expressions);
  /// Of a document that has derived fields and no model.
  ModelDescription(const MCKestrel_800::ScoreDictionary& dictionary,
                   const MCKestrel_800::TransformationDictionary& transformations,
                   const ExpressionText& expressions);
  /// Of a dictionary in the older format, without anything that reads its fields.
  explicit ModelDescription(const MCKestrel_800::ScoreDictionary& legacy);
  ~ModelDescription();

  std::string kind;        ///< empty without a model
  bool is_legacy = false;  ///< a dictionary of the older format alone
  std::string version;
  bool has_target = false;
  FieldDescription target;
  /// The model's other fields, in the document's order.
  std::vector<FieldDescription> inputs;
  std::vector<FieldDescription> derived;
  /// In the document's order.
  std::vector<OutputDescription> outputs;
};

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_MODELDESCRIPTION_H
