#include "apps/kestrel/TableWriter.h"

#include <charconv>

#include "apps/kestrel/CsvWriter.h"
#include "apps/kestrel/JsonLinesWriter.h"

namespace kestrel_program {

TableWriter::~TableWriter() = default;

std::unique_ptr<TableWriter> TableWriter::Make(Format format, const std::vector<std::string>& columns,
                                               std::string& out) {
  if (format == Format::kJsonLines) return std::make_unique<JsonLinesWriter>(columns, out);
  return std::make_unique<CsvWriter>(columns, out);
}

void AppendNumber(double number, std::string& out) {
  // The longest is "-1.2345678901234567e-308".
  char text[32];
  const std::to_chars_result end = std::to_chars(text, text + sizeof text, number);
  out.append(text, static_cast<std::size_t>(end.ptr - text));
}

}  // namespace kestrel_program
