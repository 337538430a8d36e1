// The set of input variables that a model document declares.

#ifndef KESTREL_DICTIONARY_SCOREDICTIONARY_H
#define KESTREL_DICTIONARY_SCOREDICTIONARY_H

#include <cstddef>
#include <iosfwd>
#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// Variables by exact, case-sensitive name. The dictionary owns them.
///
/// Filled on one thread while a document is read; afterwards it may be read by several threads at once.
class KESTREL_API ScoreDictionary {
 public:
  virtual ~ScoreDictionary();

  /// A deep copy, owned by the caller.
  virtual ScoreDictionary* Clone() const = 0;
  /// Adds clones of the other dictionary's variables whose names are not here yet, and takes over its list of
  /// names: names that only this dictionary held leave the list, though their variables stay. Always false,
  /// so the result says nothing about success.
  virtual bool AddVar(const ScoreDictionary* other) = 0;
  /// Adds one variable under `name` and takes ownership of it. An empty name or a null variable is refused
  /// (false). When the name is taken, the first variable stays, the name is listed a second time and the
  /// result is true all the same: the new variable is then neither kept nor deleted and still belongs to the
  /// caller, who can tell by asking `GetVar`.
  virtual bool AddVar(const std::string& name, ScoreDictVar* var) = 0;
  /// Removes and deletes one variable. The list of names is left as it is. False when there is no such
  /// variable.
  virtual bool RemoveVar(const std::string& name) = 0;
  /// The variable of that name, still owned by the dictionary, or null.
  virtual ScoreDictVar* GetVar(const std::string& name) = 0;
  virtual const ScoreDictVar* GetVar(const std::string& name) const = 0;
  /// The number of variables.
  virtual std::size_t Size() const = 0;
  /// The variables in ascending (byte-wise) order of their names, still owned by the dictionary.
  virtual std::vector<ScoreDictVar*> GetScoreDictVars() const = 0;
  /// The names in the order in which they were added, repeated and removed ones included.
  virtual std::vector<std::string> GetVarNames() const = 0;
  virtual void Display(std::ostream& os) const = 0;

  /// As long as a dictionary gives the same stamp, other than 0, it holds the same variables, and no other
  /// dictionary gives it. Derived fields keep the variables that they looked up for a stamp and ask again
  /// only when they meet another one. 0 says that nothing is promised and variables are looked up for each
  /// case.
  virtual unsigned long long GetLayoutStamp() const { return 0; }
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_SCOREDICTIONARY_H
