// Which parts of a model led to a result.

#ifndef KESTREL_MODEL_RESULTENTITIES_H
#define KESTREL_MODEL_RESULTENTITIES_H

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

class ScoreResult;

/// The parts of a model that decided a case, by their identifiers: the nodes that it passed in a tree, the
/// rules of a rule set that fired. Models of other kinds have none. A part to which the document gives no
/// identifier is called by its number in document order, from 1, behind a "#".
///
/// Names are copied for every case, so a model gives them on request only: the one entity whose score is the
/// prediction, or all that led there as well.
///
///   ResultEntities* entities = ResultEntities::Of(result.get());
///   entities->SetPathWanted(true);                  // once; stays so from case to case
///   model->Score(&record, result.get());
///   for (std::size_t i = 0; i < entities->GetPathLength(); ++i) std::cout << entities->GetPathId(i) << ' ';
///
/// Belongs to a result, which empties it with every Reset; storage is kept, so that filling it again
/// allocates nothing.
class KESTREL_API ResultEntities {
 public:
  ResultEntities();
  ~ResultEntities();

  /// The entities of a result; null for null and for a result of a class that has none.
  static ResultEntities* Of(ScoreResult* result);

  /// Whether models are to tell the deciding entity.
  void SetDecidingIdWanted(bool wanted) { deciding_id_wanted_ = wanted; }
  bool IsDecidingIdWanted() const { return deciding_id_wanted_ || path_wanted_; }
  /// Whether they are to tell all entities; the deciding one is told with them.
  void SetPathWanted(bool wanted) { path_wanted_ = wanted; }
  bool IsPathWanted() const { return path_wanted_; }

  /// The deciding entity; empty when no single one decided, or when it was not wanted.
  void SetDecidingId(std::string_view id) { deciding_id_.assign(id); }
  const std::string& GetDecidingId() const { return deciding_id_; }

  /// The entities in the order in which the case met them. Nothing is added unless the path is wanted; a
  /// model that has to look for the identifier asks IsPathWanted() first.
  void AddToPath(std::string_view id);
  std::size_t GetPathLength() const { return path_length_; }
  /// `position` is below GetPathLength().
  const std::string& GetPathId(std::size_t position) const { return path_[position]; }

  /// Forgets the case; what is wanted stays.
  void Reset() {
    deciding_id_.clear();
    path_length_ = 0;
  }

 private:
  bool deciding_id_wanted_ = false;
  bool path_wanted_ = false;
  std::string deciding_id_;
  std::vector<std::string> path_;  ///< longer than the path when an earlier case had a longer one
  std::size_t path_length_ = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_MODEL_RESULTENTITIES_H
