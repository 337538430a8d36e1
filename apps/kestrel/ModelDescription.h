// What a model is and what it reads, in words.

#ifndef KESTREL_APPS_KESTREL_MODELDESCRIPTION_H
#define KESTREL_APPS_KESTREL_MODELDESCRIPTION_H

#include <string>
#include <vector>

namespace MCKestrel_800 {
class ScoreDictVar;
class ScoreModel;
}  // namespace MCKestrel_800

namespace kestrel_program {

/// One variable of the model.
struct FieldDescription {
  struct Category {
    std::string value;
    std::string label;  ///< empty when it is the value's own text
  };

  std::string name;
  std::string label;
  std::string type;      ///< "number", "integer", "text", or the name of the date or time type
  std::string level;     ///< "continuous", "ordinal" or "nominal"
  std::string role;      ///< "predictor", "target", "supplementary", "order", "group", ...
  bool is_read = false;  ///< whether the table must have a column for it
  std::vector<Category> categories;
  std::vector<std::string> missing;  ///< single values ("-99") and intervals ("[900, 999)")
};

struct ModelDescription {
  explicit ModelDescription(const MCKestrel_800::ScoreModel& model);
  ~ModelDescription();

  std::string kind;
  std::string version;
  bool has_target = false;
  FieldDescription target;
  /// The model's other fields, in the document's order.
  std::vector<FieldDescription> inputs;
};

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_MODELDESCRIPTION_H
