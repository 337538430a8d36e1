// Names that the user gives, among those that there are.

#ifndef KESTREL_APPS_KESTREL_NAMECHOICE_H
#define KESTREL_APPS_KESTREL_NAMECHOICE_H

#include <cstddef>
#include <string>
#include <vector>

namespace kestrel_program {

/// How messages speak of the names.
struct ChoiceWords {
  const char* option;  ///< "--keep"
  const char* absent;  ///< what comes before a name that is not there: "the table has no column"
  const char* one;     ///< "the column"
  const char* many;    ///< "the columns are"
};

/// The positions of the names that are asked for, in the order of asking. Each text names one or, when there
/// is no such name, several with commas between them. Errors: ProgramError kUsage for a name that is not
/// there, which tells those that are, and for one that is asked for twice.
std::vector<std::size_t> ChooseNames(const std::vector<std::string>& names,
                                     const std::vector<std::string>& asked, const ChoiceWords& words);

/// "a, b and 12 more": as many as can be read.
std::string ListNames(const std::vector<std::string>& names);

/// The name that is the same but for upper and lower case; null when there is none.
const std::string* FindInAnyCase(const std::vector<std::string>& names, const std::string& wanted);

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_NAMECHOICE_H
