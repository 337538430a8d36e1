// Random rule sets with an evaluation of their own: predicates as a tree of values, scores as texts, nothing
// compiled and nothing shared with the library.

#ifndef KESTREL_TESTS_PLUGINS_RULESETREFERENCE_H
#define KESTREL_TESTS_PLUGINS_RULESETREFERENCE_H

#include <cstddef>
#include <random>
#include <string>
#include <utility>
#include <vector>

namespace kestrel_tests {

/// An input of the random models: a number, or three categories in their order.
struct ReferenceField {
  const char* name;
  const char* optype;
  const char* type;
  const char* categories[3];  ///< null for a number
};

constexpr ReferenceField kReferenceFields[] = {
    {"x", "continuous", "double", {nullptr, nullptr, nullptr}},
    {"z", "continuous", "double", {nullptr, nullptr, nullptr}},
    {"n", "categorical", "integer", {"1", "2", "3"}},
    {"g", "categorical", "string", {"a", "b", "c"}},
    {"r", "ordinal", "string", {"low", "mid", "high"}},
    {"q", "ordinal", "integer", {"30", "20", "10"}},
};
constexpr int kReferenceFieldCount = 6;

/// A case: by field, whether there is a value, and the number or the category's position.
struct ReferenceCell {
  bool is_missing = false;
  double value = 0.0;
};
using ReferenceCase = std::vector<ReferenceCell>;

struct ReferencePredicate {
  enum Kind { kTrue, kFalse, kSimple, kSet, kCompound };
  enum Answer { kYes, kNo, kUnknown, kSurrogateYes };

  Kind kind = kTrue;
  std::string word;  ///< the operator
  int field = 0;
  double value = 0.0;    ///< a number or a category's position
  bool members[3] = {};  ///< of a set
  std::vector<ReferencePredicate> children;

  Answer Decide(const ReferenceCase& cells) const;
  void Write(std::string& xml) const;

 private:
  Answer DecideSimple(const ReferenceCell& cell) const;
  Answer DecideCompound(const ReferenceCase& cells) const;
};

using ReferenceCounts = std::vector<std::pair<std::string, double>>;

struct ReferenceRule {
  ReferencePredicate predicate;
  std::string id;
  std::string score;  ///< empty for a compound
  double weight = 1.0;
  double confidence = 1.0;
  ReferenceCounts counts;
  std::vector<ReferenceRule> inside;
};

struct ReferenceAnswer {
  std::string prediction;  ///< empty for none
  double probability = 0.0;
  std::string deciding;
  std::vector<std::string> path;
  std::vector<std::pair<std::string, double>> categories;

  bool operator==(const ReferenceAnswer& other) const;
};

/// For failure messages.
std::string ToText(const ReferenceAnswer& answer);

/// A rule set and the evaluation of cases by it.
class ReferenceRuleSet {
 public:
  /// The same seed makes the same rule set.
  explicit ReferenceRuleSet(unsigned seed);

  std::string GetDocument() const;
  ReferenceAnswer Answer(const ReferenceCase& cells) const;
  ReferenceCase MakeCase();

 private:
  struct Firing {
    const ReferenceRule* rule;
    std::string name;
  };

  unsigned Draw(unsigned count) { return static_cast<unsigned>(random_() % count); }
  bool Chance(unsigned percent) { return Draw(100) < percent; }
  std::string DrawScore();
  ReferencePredicate MakePredicate(int depth);
  ReferencePredicate MakeTest();
  ReferencePredicate MakeCompound(int depth);
  ReferenceCounts MakeCounts();
  std::vector<ReferenceRule> MakeRules(int depth);
  void Note(const std::string& score);
  void NoteRules(const std::vector<ReferenceRule>& rules, bool distributions);
  void FindFiring(const std::vector<ReferenceRule>& rules, bool is_open, const ReferenceCase& cells,
                  int& number, std::vector<Firing>& firing) const;
  void Choose(const std::vector<Firing>& firing, ReferenceAnswer& answer) const;
  void ChooseBySum(const std::vector<Firing>& firing, ReferenceAnswer& answer) const;
  void Distribute(const ReferenceCounts& counts, ReferenceAnswer& answer) const;

  std::mt19937 random_;
  std::string criterion_;
  std::string target_;
  std::string default_score_;
  double default_confidence_ = -1.0;  ///< below 0: not given
  ReferenceCounts counts_;
  std::vector<ReferenceRule> rules_;
  std::vector<std::string> categories_;
};

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_PLUGINS_RULESETREFERENCE_H
