#include "apps/kestrel/KeptColumns.h"

#include <algorithm>
#include <unordered_map>
#include <unordered_set>

#include "apps/kestrel/ProgramError.h"
#include "apps/kestrel/ShownText.h"
#include "apps/kestrel/TableReader.h"

namespace kestrel_program {
namespace {

std::vector<std::string> SplitAtCommas(const std::string& text) {
  std::vector<std::string> parts;
  std::size_t begin = 0;
  for (std::size_t comma = text.find(','); comma != std::string::npos; comma = text.find(',', begin)) {
    parts.push_back(text.substr(begin, comma - begin));
    begin = comma + 1;
  }
  parts.push_back(text.substr(begin));
  return parts;
}

}  // namespace

std::vector<std::size_t> FindKeptColumns(TableReader& table, const std::vector<std::string>& asked) {
  std::unordered_map<std::string, std::size_t> positions;
  for (std::size_t column = 0; column < table.GetHeader().size(); ++column)
    positions.emplace(table.GetHeader()[column], column);
  std::vector<std::size_t> columns;
  std::unordered_set<std::size_t> taken;
  for (const std::string& text : asked) {
    const bool is_one = positions.count(text) != 0;
    for (const std::string& name : is_one ? std::vector<std::string>{text} : SplitAtCommas(text)) {
      const auto found = positions.find(name);
      if (found == positions.end()) {
        throw ProgramError(kUsage, "--keep: the table has no column \"" + ShownText(name) + "\"");
      }
      if (!taken.insert(found->second).second) {
        throw ProgramError(kUsage, "--keep: the column \"" + ShownText(name) + "\" is asked for twice");
      }
      columns.push_back(found->second);
    }
  }
  return columns;
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
