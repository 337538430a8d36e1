#include "apps/kestrel/CsvWriter.h"

#include <array>

namespace kestrel_program {
namespace {

/// What makes quotation marks necessary, wherever it stands in a cell.
constexpr std::array<bool, 256> MakeSpecialBytes() {
  std::array<bool, 256> special{};
  special[','] = special['"'] = special['\n'] = special['\r'] = true;
  return special;
}
constexpr std::array<bool, 256> kIsSpecial = MakeSpecialBytes();

bool IsBlank(char c) {
  return c == ' ' || c == '\t';
}

bool NeedsQuotes(std::string_view text) {
  if (text.empty()) return false;
  if (IsBlank(text.front()) || IsBlank(text.back())) return true;
  for (const char c : text) {
    if (kIsSpecial[static_cast<unsigned char>(c)]) return true;
  }
  return false;
}

}  // namespace

CsvWriter::CsvWriter(const std::vector<std::string>& columns, std::string& out)
    : columns_(columns), out_(out) {}

CsvWriter::~CsvWriter() = default;

void CsvWriter::BeginTable() {
  for (const std::string& column : columns_)
    AddText(column);
  EndRow();
}

void CsvWriter::AddText(std::string_view text) {
  if (text.empty()) return AddMissing();
  Separate();
  if (!NeedsQuotes(text)) {
    out_.append(text);
    return;
  }
  out_.push_back('"');
  for (const char c : text) {
    if (c == '"') out_.push_back('"');
    out_.push_back(c);
  }
  out_.push_back('"');
}

void CsvWriter::AddNumber(double number) {
  Separate();
  out_.append(numbers_.Get(number));
}

void CsvWriter::AddMissing() {
  Separate();
  if (columns_.size() == 1) out_.append("\"\"");
}

// Joined before they are written, since one of them may need quotation marks around all.
void CsvWriter::AddList(const std::vector<std::string_view>& texts) {
  joined_.clear();
  for (std::size_t i = 0; i < texts.size(); ++i)
    joined_.append(i == 0 ? "" : " > ").append(texts[i]);
  AddText(joined_);
}

void CsvWriter::EndRow() {
  out_.push_back('\n');
  at_start_ = true;
}

}  // namespace kestrel_program
