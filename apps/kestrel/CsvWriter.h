// Comma separated values.

#ifndef KESTREL_APPS_KESTREL_CSVWRITER_H
#define KESTREL_APPS_KESTREL_CSVWRITER_H

#include <string>
#include <string_view>
#include <vector>

#include "apps/kestrel/TableWriter.h"

namespace kestrel_program {

/// Quotation marks enclose a cell that would not read back as it is without them: one with commas, quotation
/// marks or line ends in it, with blanks around it, and the empty cell of a table with one column, whose line
/// would else be blank. A missing cell is empty. Lines end with LF.
class CsvWriter : public TableWriter {
 public:
  CsvWriter(const std::vector<std::string>& columns, std::string& out);
  ~CsvWriter() override;

  void BeginTable() override;
  void AddText(std::string_view text) override;
  void AddNumber(double number) override;
  void AddMissing() override;
  void AddList(const std::vector<std::string_view>& texts) override;
  void EndRow() override;

 private:
  void Separate() {
    if (!at_start_) out_.push_back(',');
    at_start_ = false;
  }

  std::vector<std::string> columns_;
  std::string& out_;
  std::string joined_;  ///< the list being written
  NumberTexts numbers_;
  bool at_start_ = true;
};

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_CSVWRITER_H
