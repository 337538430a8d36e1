// The folders of examples/ that hold a model with its data and the training program's answers, or derived
// fields with data and what they are.

#ifndef KESTREL_TESTS_EXAMPLES_EXAMPLEFOLDERS_H
#define KESTREL_TESTS_EXAMPLES_EXAMPLEFOLDERS_H

#include <algorithm>
#include <cmath>
#include <filesystem>
#include <string>
#include <vector>

namespace kestrel_tests {

inline std::string ExamplePath(const std::string& example, const std::string& file) {
  return std::string(KESTREL_SOURCE_DIR) + "/examples/" + example + "/" + file;
}

inline std::vector<std::string> FoldersWith(const std::string& file) {
  std::vector<std::string> names;
  for (const auto& entry :
       std::filesystem::directory_iterator(std::string(KESTREL_SOURCE_DIR) + "/examples")) {
    if (std::filesystem::exists(entry.path() / file)) names.push_back(entry.path().filename().string());
  }
  std::sort(names.begin(), names.end());
  return names;
}

/// Those with a model.
inline std::vector<std::string> ExampleFolders() {
  return FoldersWith("expected.csv");
}

/// Those with derived fields alone.
inline std::vector<std::string> DerivedExampleFolders() {
  return FoldersWith("derived.csv");
}

/// Those whose documents declare output fields.
inline std::vector<std::string> OutputExampleFolders() {
  return FoldersWith("outputs.csv");
}

/// The model elements that examples hold.
inline const std::vector<std::string>& ExampleKinds() {
  static const std::vector<std::string> kinds = {"RegressionModel", "TreeModel", "RuleSetModel"};
  return kinds;
}

/// A test name may hold letters and digits only.
inline std::string TestNameOf(const std::string& folder) {
  std::string name;
  for (const char c : folder) {
    if (c != '-') name += c;
  }
  return name;
}

/// The training programs and we add the same terms in different orders; over all examples that costs less
/// than this.
constexpr double kTolerance = 1e-12;

inline bool AgreesWith(double expected, double actual) {
  return std::abs(expected - actual) <= kTolerance * std::max(std::abs(expected), std::abs(actual));
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_EXAMPLES_EXAMPLEFOLDERS_H
