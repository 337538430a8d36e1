// One JSON object a line.

#ifndef KESTREL_APPS_KESTREL_JSONLINESWRITER_H
#define KESTREL_APPS_KESTREL_JSONLINESWRITER_H

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "apps/kestrel/TableWriter.h"

namespace kestrel_program {

/// The columns' names are the keys. A missing cell is null, and so is a number that JSON has no word for
/// (infinity and what is no number). Bytes that are not UTF-8 become the replacement character.
class JsonLinesWriter : public TableWriter {
 public:
  JsonLinesWriter(const std::vector<std::string>& columns, std::string& out);
  ~JsonLinesWriter() override;

  void BeginTable() override;
  void AddText(std::string_view text) override;
  void AddNumber(double number) override;
  void AddMissing() override;
  void AddList(const std::vector<std::string_view>& texts) override;
  void EndRow() override;

 private:
  std::vector<std::string> keys_;  ///< with all that stands before the cell's value
  std::size_t next_ = 0;
  std::string& out_;
  NumberTexts numbers_;
};

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_JSONLINESWRITER_H
