#include "apps/kestrel/NameChoice.h"

#include <algorithm>
#include <unordered_map>
#include <unordered_set>

#include "apps/kestrel/ProgramError.h"
#include "apps/kestrel/ShownText.h"

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

std::string InLowerCase(std::string text) {
  for (char& c : text) {
    if (c >= 'A' && c <= 'Z') c = static_cast<char>(c - 'A' + 'a');
  }
  return text;
}

[[noreturn]] void FailOnAbsent(const std::vector<std::string>& names, const std::string& wanted,
                               const ChoiceWords& words) {
  std::string text = std::string(words.option) + ": " + words.absent + " \"" + ShownText(wanted) + "\"; " +
                     words.many + " " + ListNames(names);
  if (const std::string* similar = FindInAnyCase(names, wanted)) {
    text += "\n  hint: upper and lower case count; there is " + ShownText(*similar);
  }
  throw ProgramError(kUsage, text);
}

}  // namespace

std::vector<std::size_t> ChooseNames(const std::vector<std::string>& names,
                                     const std::vector<std::string>& asked, const ChoiceWords& words) {
  std::unordered_map<std::string, std::size_t> positions;
  for (std::size_t i = 0; i < names.size(); ++i)
    positions.emplace(names[i], i);
  std::vector<std::size_t> chosen;
  std::unordered_set<std::size_t> taken;
  for (const std::string& text : asked) {
    const bool is_one = positions.count(text) != 0;
    for (const std::string& name : is_one ? std::vector<std::string>{text} : SplitAtCommas(text)) {
      const auto found = positions.find(name);
      if (found == positions.end()) FailOnAbsent(names, name, words);
      if (!taken.insert(found->second).second) {
        throw ProgramError(kUsage, std::string(words.option) + ": " + words.one + " \"" + ShownText(name) +
                                       "\" is asked for twice");
      }
      chosen.push_back(found->second);
    }
  }
  return chosen;
}

std::string ListNames(const std::vector<std::string>& names) {
  constexpr std::size_t kMost = 30;
  std::string list;
  for (std::size_t i = 0; i < names.size() && i < kMost; ++i)
    list += (i == 0 ? "" : ", ") + ShownText(names[i]);
  if (names.size() > kMost) list += " and " + std::to_string(names.size() - kMost) + " more";
  return list;
}

const std::string* FindInAnyCase(const std::vector<std::string>& names, const std::string& wanted) {
  const std::string text = InLowerCase(wanted);
  const auto found = std::find_if(names.begin(), names.end(),
                                  [&text](const std::string& name) { return InLowerCase(name) == text; });
  return found == names.end() ? nullptr : &*found;
}

}  // namespace kestrel_program
