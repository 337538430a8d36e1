#include "apps/kestrel/DocumentInput.h"

#include <array>
#include <fstream>
#include <iostream>
#include <sstream>
#include <streambuf>

#include "apps/kestrel/InputFile.h"

namespace kestrel_program {

/// Passes the standard input on and keeps a copy. How long that can get is up to the reader of documents,
/// which stops at a limit.
class DocumentInput::KeepingBuffer : public std::streambuf {
 public:
  const std::string& GetText() const { return text_; }

 protected:
  int_type underflow() override {
    std::cin.read(block_.data(), static_cast<std::streamsize>(block_.size()));
    const auto size = static_cast<std::size_t>(std::cin.gcount());
    if (size == 0) return traits_type::eof();
    text_.append(block_.data(), size);
    setg(block_.data(), block_.data(), block_.data() + size);
    return traits_type::to_int_type(block_[0]);
  }

 private:
  std::array<char, 65536> block_;
  std::string text_;
};

DocumentInput::DocumentInput(const std::string& path)
    : path_(path), name_(IsStandardStream(path) ? "standard input" : path) {}

DocumentInput::~DocumentInput() = default;

std::istream& DocumentInput::Open() {
  if (!IsStandardStream(path_)) {
    stream_ = std::make_unique<std::ifstream>(OpenForReading(path_));
  } else if (kept_ == nullptr) {
    kept_ = std::make_unique<KeepingBuffer>();
    stream_ = std::make_unique<std::istream>(kept_.get());
  } else {
    stream_ = std::make_unique<std::istringstream>(kept_->GetText());
  }
  return *stream_;
}

bool DocumentInput::Holds(const std::string& text) {
  std::istream& in = Open();
  std::array<char, 65536> block;
  std::string seen;
  while (in.read(block.data(), static_cast<std::streamsize>(block.size())), in.gcount() > 0) {
    seen.append(block.data(), static_cast<std::size_t>(in.gcount()));
    if (seen.find(text) != std::string::npos) return true;
    // It may begin in one block and end in the next.
    if (seen.size() >= text.size()) seen.erase(0, seen.size() - (text.size() - 1));
  }
  return false;
}

}  // namespace kestrel_program
