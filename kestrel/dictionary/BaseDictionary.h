// The one implementation of ScoreDictionary.

#ifndef KESTREL_DICTIONARY_BASEDICTIONARY_H
#define KESTREL_DICTIONARY_BASEDICTIONARY_H

#include <map>
#include <memory>
#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreDictionary.h"

namespace MCKestrel_800 {

/// A dictionary held as an ordered map of owned variables beside the list of names in order of arrival.
class KESTREL_API BaseDictionary : public ScoreDictionary {
 public:
  BaseDictionary();
  BaseDictionary(const BaseDictionary& other);
  BaseDictionary& operator=(const BaseDictionary& other);
  ~BaseDictionary() override;

  BaseDictionary* Clone() const override;
  bool AddVar(const ScoreDictionary* other) override;
  bool AddVar(const std::string& name, ScoreDictVar* var) override;
  bool RemoveVar(const std::string& name) override;
  ScoreDictVar* GetVar(const std::string& name) override;
  const ScoreDictVar* GetVar(const std::string& name) const override;
  std::size_t Size() const override;
  std::vector<ScoreDictVar*> GetScoreDictVars() const override;
  std::vector<std::string> GetVarNames() const override;
  void Display(std::ostream& os) const override;
  unsigned long long GetLayoutStamp() const override;

 private:
  std::map<std::string, std::unique_ptr<ScoreDictVar>> vars_;
  std::vector<std::string> names_;
  unsigned long long stamp_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_BASEDICTIONARY_H
