// From a number that names a category to the category's code.

#ifndef KESTREL_PLUGINS_SUPPORT_NUMBERCODES_H
#define KESTREL_PLUGINS_SUPPORT_NUMBERCODES_H

#include <map>
#include <vector>

namespace MCKestrel_800 {

/// Numbers with their codes, found by NumericValue::IsEqual: of several equal ones the one added first.
/// Filled on one thread with Add, then sealed, then only read. Looking up in what is sealed is a binary
/// search in an array; looking up never allocates.
class NumberCodes {
 public:
  static constexpr int kUnknown = -1;

  /// Adds a number with its code, unless an equal one is there already. Returns the code that it has
  /// afterwards. Not to be called after Seal.
  int Add(double number, int code);

  /// Lays the numbers out for Find.
  void Seal();

  /// The number's code, or kUnknown.
  int Find(double number) const;

 private:
  struct Entry {
    double number;
    int rank;  ///< when it was added
    int code;
  };

  const Entry* FindBuilding(double number) const;

  std::map<double, Entry> building_;
  std::vector<Entry> entries_;  ///< ascending
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_NUMBERCODES_H
