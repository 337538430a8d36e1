// The rules of a set in document order, flat, with the way around those that are not asked.

#ifndef KESTREL_PLUGINS_RULE_SET_RULETABLE_H
#define KESTREL_PLUGINS_RULE_SET_RULETABLE_H

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "kestrel/predicates/ScorePredicate.h"
#include "plugins/rule_set/DistributionTable.h"
#include "plugins/support/ConditionTable.h"

namespace MCKestrel_800 {

/// Each `SimpleRule` and `CompoundRule` is one entry; the rules inside a compound follow it. An entry's
/// condition knows the entry behind all that is inside, which is the next one to ask when it is not true.
///
/// A rule fires when its predicate is true, by a surrogate or not, and those of all compounds around it are;
/// an unknown predicate does not fire.
///
/// Built on one thread, then only read.
class RuleTable {
 public:
  static constexpr int kNone = -1;

  struct Rule {
    double weight = 1.0;
    double confidence = 1.0;
    int score = kNone;  ///< position among the rule set's scores; kNone for a compound rule
    int distribution = DistributionTable::kNone;
  };

  /// What the rules' conditions are compiled with.
  ConditionTable& GetConditions() { return parts_; }

  /// Appends a rule and returns its number. What is added until a compound rule is closed is inside it.
  /// condition  of this table's GetConditions().
  /// id         of a rule that predicts; empty: it is called "#" and its number among those, from 1.
  int Add(const Condition& condition, const Rule& rule, std::string_view id);
  void Close(int compound) { conditions_[compound].next = GetCount(); }

  void SetDistribution(int rule, int distribution) { rules_[rule].distribution = distribution; }

  /// Gives back the room that building needed.
  void Seal();

  /// Entries of both kinds.
  int GetCount() const { return static_cast<int>(rules_.size()); }
  const Rule& Get(int rule) const { return rules_[rule]; }
  /// Empty for a compound rule.
  std::string_view GetId(int rule) const;
  /// The entry behind all that is inside this one.
  int GetNext(int rule) const { return conditions_[rule].next; }

  /// Calls `visit` with the number of each rule that predicts and fires, in document order, until it returns
  /// false. `values` are a CaseVector's.
  template <typename Visit>
  void VisitFiring(const double* values, Visit visit) const {
    const int end = GetCount();
    for (int rule = 0; rule < end;) {
      const ScorePredicate::PredicateResult result = parts_.Evaluate(conditions_[rule], values);
      if (result != ScorePredicate::PredTrue && result != ScorePredicate::PredSurrogateTrue) {
        rule = conditions_[rule].next;
        continue;
      }
      if (rules_[rule].score != kNone && !visit(rule)) return;
      ++rule;
    }
  }

 private:
  // By entry, and apart from what only rules that fire need: most of a case's time goes into conditions.
  std::vector<Condition> conditions_;
  std::vector<Rule> rules_;
  ConditionTable parts_;
  std::string ids_;
  std::vector<std::size_t> id_ends_;
  int simple_count_ = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_RULE_SET_RULETABLE_H
