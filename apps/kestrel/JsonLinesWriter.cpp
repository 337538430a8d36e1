#include "apps/kestrel/JsonLinesWriter.h"

#include <algorithm>
#include <cmath>
#include <nlohmann/json.hpp>

namespace kestrel_program {
namespace {

bool IsPlain(char c) {
  return c >= ' ' && c <= '~' && c != '"' && c != '\\';
}

void AppendQuoted(std::string_view text, std::string& out) {
  if (std::all_of(text.begin(), text.end(), IsPlain)) {
    out.push_back('"');
    out.append(text);
    out.push_back('"');
    return;
  }
  out += nlohmann::json(text).dump(-1, ' ', false, nlohmann::json::error_handler_t::replace);
}

}  // namespace

JsonLinesWriter::JsonLinesWriter(const std::vector<std::string>& columns, std::string& out) : out_(out) {
  for (const std::string& column : columns) {
    std::string key = keys_.empty() ? "{" : ",";
    AppendQuoted(column, key);
    keys_.push_back(key + ":");
  }
}

JsonLinesWriter::~JsonLinesWriter() = default;

void JsonLinesWriter::BeginTable() {}

void JsonLinesWriter::AddText(std::string_view text) {
  out_.append(keys_[next_++]);
  AppendQuoted(text, out_);
}

void JsonLinesWriter::AddNumber(double number) {
  if (!std::isfinite(number)) return AddMissing();
  out_.append(keys_[next_++]);
  out_.append(numbers_.Get(number));
}

void JsonLinesWriter::AddMissing() {
  out_.append(keys_[next_++]);
  out_.append("null");
}

void JsonLinesWriter::AddList(const std::vector<std::string_view>& texts) {
  out_.append(keys_[next_++]);
  out_.push_back('[');
  for (std::size_t i = 0; i < texts.size(); ++i) {
    if (i > 0) out_.push_back(',');
    AppendQuoted(texts[i], out_);
  }
  out_.push_back(']');
}

void JsonLinesWriter::EndRow() {
  out_.append("}\n");
  next_ = 0;
}

}  // namespace kestrel_program
