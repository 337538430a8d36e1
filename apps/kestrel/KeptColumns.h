// The columns of a table that are copied into the output.

#ifndef KESTREL_APPS_KESTREL_KEPTCOLUMNS_H
#define KESTREL_APPS_KESTREL_KEPTCOLUMNS_H

#include <cstddef>
#include <string>
#include <vector>

namespace kestrel_program {

class TableReader;

/// The positions in the header of the columns that are asked for, in the order of asking. Each text names one
/// column or, when there is no such column, several with commas between them. Errors: ProgramError kUsage for
/// a name that the header does not have, and for one that is asked for twice.
std::vector<std::size_t> FindKeptColumns(TableReader& table, const std::vector<std::string>& asked);

/// Names for the output's columns, the kept ones and those that are added behind them, all different: a name
/// that is taken (only unnamed columns share one in a table) gets "_2" behind it, or the next number that is
/// free.
std::vector<std::string> NameOutputColumns(const std::vector<std::string>& kept,
                                           const std::vector<std::string>& added);

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_KEPTCOLUMNS_H
