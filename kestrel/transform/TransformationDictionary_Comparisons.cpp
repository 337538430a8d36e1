#include <memory>
#include <stdexcept>

#include "kestrel/dictionary/ScoreValueLabel.h"
#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/transform/FunctionEvaluation.h"
#include "kestrel/transform/TransformationDictionary.h"

namespace MCKestrel_800 {

namespace {

/// Deletes the values of a list when a comparison ends, however it ends.
class ListOwner {
 public:
  explicit ListOwner(std::vector<ScoreValue*>& values) : values_(values) {}
  ListOwner(const ListOwner&) = delete;
  ListOwner& operator=(const ListOwner&) = delete;
  ~ListOwner() {
    for (ScoreValue* value : values_)
      delete value;
    values_.clear();
  }

 private:
  std::vector<ScoreValue*>& values_;
};

bool AreTwoEqual(std::vector<ScoreValue*>& values) {
  const bool are_two = values.size() == 2 && values[0] != nullptr && values[1] != nullptr;
  if (are_two && values[0]->GetType() != values[1]->GetType()) return false;
  const ListOwner owner(values);
  return are_two && AreEqualValues(*values[0], *values[1]);
}

bool IsArgumentAmong(std::vector<ScoreValue*>& values, ScoreValue* argument) {
  const ListOwner owner(values);
  const std::unique_ptr<ScoreValue> owned(argument);
  return argument != nullptr && IsAmong(*argument, {values.begin(), values.end()});
}

}  // namespace

double TransformationDictionary::equal(std::vector<ScoreValue*>& values) {
  return AreTwoEqual(values) ? 1.0 : 0.0;
}

double TransformationDictionary::notEqual(std::vector<ScoreValue*>& values) {
  return AreTwoEqual(values) ? 0.0 : 1.0;
}

double TransformationDictionary::isIn(std::vector<ScoreValue*>& values, ScoreValue* argument) {
  return IsArgumentAmong(values, argument) ? 1.0 : 0.0;
}

double TransformationDictionary::isNotIn(std::vector<ScoreValue*>& values, ScoreValue* argument) {
  return IsArgumentAmong(values, argument) ? 0.0 : 1.0;
}

const ScoreValue* TransformationDictionary::ImputeCatFieldMissingAgainstConTargetHandle(
    double t, const std::vector<ScoreValueLabel*>& categories, const std::vector<double>& means,
    const std::vector<double>& variances) {
  if (!means.empty() && variances.size() >= means.size()) {
    const std::size_t nearest = NearestMean(t, means.data(), variances.data(), means.size());
    if (nearest < categories.size()) {
      const ScoreValueLabel* label = categories[nearest];
      return label == nullptr ? nullptr : label->GetValue();
    }
  }
  throw std::out_of_range("invalid vector<T> subscript");
}

}  // namespace MCKestrel_800
