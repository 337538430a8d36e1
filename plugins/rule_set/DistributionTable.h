// How scores are distributed where a rule fires, flat.

#ifndef KESTREL_PLUGINS_RULE_SET_DISTRIBUTIONTABLE_H
#define KESTREL_PLUGINS_RULE_SET_DISTRIBUTIONTABLE_H

#include <cstddef>
#include <vector>

namespace MCKestrel_800 {

/// Distributions by number. Only what documents give is kept: a score that a distribution does not name takes
/// no room.
class DistributionTable {
 public:
  /// The number of what is no distribution.
  static constexpr int kNone = -1;

  struct Share {
    int score;  ///< position among the rule set's scores
    double probability;
  };

  /// Appends a distribution and returns its number.
  int Add(const std::vector<Share>& shares);

  /// Gives back the room that building needed.
  void Seal();

  /// Writes the probabilities of all scores, by position; 0 for those that the distribution does not name.
  void Fill(int distribution, std::vector<double>& probabilities) const;

 private:
  std::vector<Share> shares_;
  std::vector<std::size_t> ends_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_RULE_SET_DISTRIBUTIONTABLE_H
