#include "apps/kestrel/KeptColumns.h"

#include <algorithm>
#include <unordered_set>

#include "apps/kestrel/NameChoice.h"
#include "apps/kestrel/TableReader.h"

namespace kestrel_program {
namespace {

constexpr ChoiceWords kWords = {"--keep", "the table has no column", "the column", "the columns are"};

}  // namespace

std::vector<std::size_t> FindKeptColumns(TableReader& table, const std::vector<std::string>& asked) {
  return ChooseNames(table.GetHeader(), asked, kWords);
}

std::vector<std::string> NameOutputColumns(const std::vector<std::string>& kept,
                                           const std::vector<std::string>& added) {
  std::vector<std::string> names;
  std::unordered_set<std::string> taken;
  const auto add = [&names, &taken](const std::string& wanted) {
    std::string name = wanted;
    for (int number = 2; !taken.insert(name).second; ++number)
      name = wanted + "_" + std::to_string(number);
    names.push_back(name);
  };
  std::for_each(kept.begin(), kept.end(), add);
  std::for_each(added.begin(), added.end(), add);
  return names;
}

}  // namespace kestrel_program
