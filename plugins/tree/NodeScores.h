// What the nodes of a tree predict, and what they are called.

#ifndef KESTREL_PLUGINS_TREE_NODESCORES_H
#define KESTREL_PLUGINS_TREE_NODESCORES_H

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "kestrel/foundation/NumericValue.h"

namespace MCKestrel_800 {

/// One category in a node's distribution.
struct CategoryShare {
  int category;  ///< its number among the target's categories
  double record_count;
  double probability;
  double confidence;
};

/// The scores of all nodes by their numbers, in columns, of which those that a model does not need stay
/// empty.
///
/// Built node by node in document order, then sealed; then only read.
class NodeScores {
 public:
  static constexpr int kNoCategory = -1;
  static constexpr int kNoChild = -1;

  /// What one node adds.
  struct Node {
    std::string_view id;                         ///< empty for none
    double number = NumericValue::gSysmisValue;  ///< a regression's score; system-missing for none
    int winner = kNoCategory;                    ///< a classification's score
    double record_count = NumericValue::gSysmisValue;
  };
  /// Which columns the model needs.
  struct Columns {
    bool is_classification = false;
    bool has_record_counts = false;
    bool has_default_children = false;
  };

  explicit NodeScores(Columns columns) : columns_(columns) {}

  /// shares  the node's distribution, ascending by category; empty for a regression.
  void Add(const Node& node, const std::vector<CategoryShare>& shares);
  void SetDefaultChild(int node, int child) { default_children_[At(node)] = child; }
  /// Gives back the room that building needed.
  void Seal();

  double GetNumber(int node) const { return numbers_[At(node)]; }
  int GetWinner(int node) const { return winners_[At(node)]; }
  double GetRecordCount(int node) const { return record_counts_[At(node)]; }
  int GetDefaultChild(int node) const { return default_children_[At(node)]; }
  bool HasScore(int node) const {
    return columns_.is_classification ? GetWinner(node) != kNoCategory
                                      : !NumericValue::IsSystemMissingValue(GetNumber(node));
  }
  /// A classification's distribution, ascending by category.
  const CategoryShare* FirstShare(int node) const { return shares_.data() + share_starts_[At(node)]; }
  const CategoryShare* EndOfShares(int node) const { return shares_.data() + share_starts_[At(node) + 1]; }
  bool HasDistribution(int node) const { return FirstShare(node) != EndOfShares(node); }

  /// The node's identifier; empty for none.
  std::string_view GetId(int node) const;

  /// The bytes that the columns hold beside the distributions and the identifiers' texts.
  std::size_t GetMemorySize() const;

 private:
  static std::size_t At(int node) { return static_cast<std::size_t>(node); }

  Columns columns_;
  std::vector<double> numbers_;
  std::vector<std::int32_t> winners_;
  std::vector<double> record_counts_;
  std::vector<std::int32_t> default_children_;
  std::vector<std::uint32_t> share_starts_;  ///< by node, and the end of all
  std::vector<CategoryShare> shares_;
  std::vector<std::uint32_t> id_ends_;  ///< empty while no node has an identifier
  std::string ids_;
  std::size_t count_ = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_TREE_NODESCORES_H
