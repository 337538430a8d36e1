#include "apps/kestrel/TableWriter.h"

#include <cstring>

#include "apps/kestrel/CsvWriter.h"
#include "apps/kestrel/JsonLinesWriter.h"
#include "kestrel/foundation/NumberText.h"

namespace kestrel_program {

TableWriter::~TableWriter() = default;

std::unique_ptr<TableWriter> TableWriter::Make(Format format, const std::vector<std::string>& columns,
                                               std::string& out) {
  if (format == Format::kJsonLines) return std::make_unique<JsonLinesWriter>(columns, out);
  return std::make_unique<CsvWriter>(columns, out);
}

void AppendNumber(double number, std::string& out) {
  char text[MCKestrel_800::kShortestRoom];
  out.append(text, MCKestrel_800::FormatShortest(number, text));
}

std::string_view NumberTexts::Get(double number) {
  std::uint64_t bits = 0;
  std::memcpy(&bits, &number, sizeof bits);
  // A multiplication by an odd number without pattern carries every bit into the upper ones.
  Entry& entry = entries_[(bits * 0x9E3779B97F4A7C15u) >> (64 - kIndexBits)];
  if (entry.bits != bits || entry.length == 0) {
    entry.bits = bits;
    entry.length = MCKestrel_800::FormatShortest(number, entry.text);
  }
  return std::string_view(entry.text, entry.length);
}

}  // namespace kestrel_program
