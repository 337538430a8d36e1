#include "kestrel/model/ModelNames.h"

#include <cstddef>
#include <cstring>
#include <fstream>

#include "kestrel/foundation/ExtNameStr.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/translate/ReaderFault.h"

namespace MCKestrel_800 {
namespace {

constexpr char kUtf8Mark[] = "\xEF\xBB\xBF";

/// Cuts a text that arrives in blocks into tags; a tag may begin in one block and end in the next.
class Tokenizer {
 public:
  explicit Tokenizer(std::vector<std::string>& tokens) : tokens_(tokens) {}

  void Take(const char* text, size_t length) {
    for (size_t i = 0; i < length; ++i) {
      if (IsSeparator(text[i])) {
        Finish();
      } else {
        token_ += text[i];
      }
    }
  }

  void Finish() {
    if (!token_.empty()) tokens_.push_back(token_);
    token_.clear();
  }

 private:
  static bool IsSeparator(char c) { return c == ' ' || c == ',' || c == '\t' || c == '\n' || c == '\r'; }

  std::vector<std::string>& tokens_;
  std::string token_;
};

}  // namespace

void ReadModelNames(const std::string& path, std::vector<std::string>& names) {
  names.clear();
  std::ifstream in;
  MCXML_800::ExtNameStr(path.empty() ? "modeldll.txt" : path).Open(in);
  Tokenizer tokenizer(names);
  char block[4096];
  in.read(block, 3);
  if (in.gcount() < 3 || std::memcmp(block, kUtf8Mark, 3) != 0) {
    tokenizer.Take(block, static_cast<size_t>(in.gcount()));
  }
  while (in.good()) {
    in.read(block, sizeof block);
    tokenizer.Take(block, static_cast<size_t>(in.gcount()));
  }
  tokenizer.Finish();
  // A folder opens as a file does on some systems and fails only when it is read.
  if (!in.is_open() || in.bad()) {
    names.clear();
    Fail(KestrelException::kFile, "Could not open model names file");
  }
}

}  // namespace MCKestrel_800
