// The rules of compound predicates once more, for tests.

#ifndef KESTREL_TESTS_PREDICATES_COMPOUNDRULES_H
#define KESTREL_TESTS_PREDICATES_COMPOUNDRULES_H

#include <algorithm>
#include <cstddef>
#include <string>

#include "kestrel/predicates/ScorePredicate.h"

namespace MCKestrel_800 {

/// One letter a result: true, false, unknown, true by a surrogate; their numbers are the letters' positions.
constexpr char kLetters[] = "TFUS";

inline char LetterOf(ScorePredicate::PredicateResult result) {
  return kLetters[result];
}

/// What a compound is for children of these results, and how many of them are asked.
struct Verdict {
  char letter;
  std::size_t asked;
};

/// Told from the whole list of results, such as "TFU", where the predicate goes through it.
inline Verdict VerdictOf(ScorePredicate::CompoundBoolOperator boolOperator, const std::string& children) {
  const auto has = [&](char letter) { return children.find(letter) != std::string::npos; };
  const auto upTo = [&](std::size_t position) { return std::min(position, children.size() - 1) + 1; };
  if (boolOperator == ScorePredicate::kSurrogate) {
    if (children.empty()) return {'U', 0};
    const std::size_t known = children.find_first_not_of('U');
    if (known == std::string::npos) return {'U', children.size()};
    return {known > 0 && children[known] == 'T' ? 'S' : children[known], known + 1};
  }
  if (children.empty()) return {boolOperator == ScorePredicate::kAnd ? 'T' : 'F', 0};
  if (boolOperator == ScorePredicate::kOr)
    return {has('T') ? 'T' : has('U') ? 'U' : 'F', upTo(children.find('T'))};
  if (boolOperator == ScorePredicate::kAnd)
    return {has('F') ? 'F' : has('U') ? 'U' : 'T', upTo(children.find('F'))};
  const bool isOdd = std::count(children.begin(), children.end(), 'T') % 2 == 1;
  return {has('U') ? 'U' : isOdd ? 'T' : 'F', upTo(children.find('U'))};
}

}  // namespace MCKestrel_800

#endif  // KESTREL_TESTS_PREDICATES_COMPOUNDRULES_H
