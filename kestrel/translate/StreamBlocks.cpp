#include "kestrel/translate/StreamBlocks.h"

#include <algorithm>
#include <cstring>
#include <istream>

#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

constexpr size_t kFirstBlockBytes = size_t{64} << 10;
constexpr size_t kMaxBlockBytes = size_t{4} << 20;
// The stream is asked for this much at a time.
constexpr size_t kReadBytes = size_t{64} << 10;

// Walks UTF-8 byte by byte, because a character may lie across blocks, and counts lines and columns.
class Utf8Walk {
 public:
  // False at a byte that cannot stand here.
  bool Take(unsigned char byte) {
    if (missing_ == 0) return Start(byte);
    if (byte < lowest_ || byte > highest_) return false;
    lowest_ = 0x80;
    highest_ = 0xBF;
    --missing_;
    return true;
  }
  // Where the last character began.
  StreamBlocks::Place GetPlace() const { return {line_, column_}; }
  bool IsInside() const { return missing_ != 0; }

 private:
  bool Start(unsigned char byte) {
    const bool isNewLine = last_ == '\r' ? byte != '\n' : last_ == '\n';
    // The byte order mark has no column.
    if (isNewLine) {
      ++line_;
      column_ = 1;
    } else if (last_ != 0xEF || line_ != 1 || column_ != 1) {
      ++column_;
    }
    last_ = byte;
    if (byte < 0x80) return true;
    if (byte < 0xC2 || byte > 0xF4) return false;
    missing_ = byte < 0xE0 ? 1 : byte < 0xF0 ? 2 : 3;
    lowest_ = byte == 0xE0 ? 0xA0 : byte == 0xF0 ? 0x90 : 0x80;
    highest_ = byte == 0xED ? 0x9F : byte == 0xF4 ? 0x8F : 0xBF;
    return true;
  }

  size_t line_ = 1;
  size_t column_ = 0;
  unsigned char last_ = 0;  // the first byte of the last character
  unsigned missing_ = 0;
  unsigned char lowest_ = 0x80;
  unsigned char highest_ = 0xBF;
};

// Turns a stream's exceptions off for as long as it lives.
class QuietStream {
 public:
  explicit QuietStream(std::istream& in) : in_(in), mask_(in.exceptions()) {
    in_.exceptions(std::ios_base::goodbit);
  }
  ~QuietStream() {
    if (mask_ == std::ios_base::goodbit) return;
    in_.clear(in_.rdstate() & ~mask_);
    // A stream without a buffer is bad whatever it is set to, and would throw.
    if (in_.rdbuf() != nullptr) in_.exceptions(mask_);
  }
  QuietStream(const QuietStream&) = delete;
  QuietStream& operator=(const QuietStream&) = delete;

 private:
  std::istream& in_;
  std::ios_base::iostate mask_;
};

class BlockStream final : public xercesc::BinInputStream {
 public:
  explicit BlockStream(const StreamBlocks& blocks) : blocks_(blocks) {}
  XMLFilePos curPos() const override { return position_; }
  XMLSize_t readBytes(XMLByte* const to, const XMLSize_t max) override {
    const size_t count = blocks_.CopyFrom(position_, to, max);
    position_ += count;
    return count;
  }
  const XMLCh* getContentType() const override { return nullptr; }

 private:
  const StreamBlocks& blocks_;
  size_t position_ = 0;
};

}  // namespace

StreamBlocks::Outcome StreamBlocks::Read(std::istream& in, size_t maxBytes) {
  if (in.bad() || (in.fail() && !in.eof())) return Outcome::kFailed;
  QuietStream quiet(in);
  return ReadBlocks(in, maxBytes);
}

StreamBlocks::Outcome StreamBlocks::ReadBlocks(std::istream& in, size_t maxBytes) {
  size_t blockBytes = kFirstBlockBytes;
  while (in.good()) {
    blocks_.push_back({std::unique_ptr<char[]>(new char[blockBytes]), size_, 0});
    Block& block = blocks_.back();
    while (in.good() && block.size < blockBytes) {
      in.read(block.bytes.get() + block.size,
              static_cast<std::streamsize>(std::min(kReadBytes, blockBytes - block.size)));
      block.size += static_cast<size_t>(in.gcount());
      size_ = block.start + block.size;
      if (size_ > maxBytes) return Outcome::kTooLarge;
    }
    blockBytes = std::min(blockBytes * 2, kMaxBlockBytes);
  }
  return in.bad() ? Outcome::kFailed : Outcome::kComplete;
}

StreamBlocks::Place StreamBlocks::FindMalformedUtf8() const {
  Utf8Walk walk;
  for (const Block& block : blocks_) {
    for (size_t i = 0; i < block.size; ++i) {
      if (!walk.Take(static_cast<unsigned char>(block.bytes[i]))) return walk.GetPlace();
    }
  }
  return walk.IsInside() ? walk.GetPlace() : Place();
}

size_t StreamBlocks::CopyFrom(size_t position, unsigned char* to, size_t max) const {
  size_t copied = 0;
  while (copied < max && position < size_) {
    // The last block that starts at or before the position.
    auto block =
        std::upper_bound(blocks_.begin(), blocks_.end(), position,
                         [](size_t value, const Block& candidate) { return value < candidate.start; });
    --block;
    const size_t offset = position - block->start;
    const size_t count = std::min(max - copied, block->size - offset);
    if (count == 0) break;
    std::memcpy(to + copied, block->bytes.get() + offset, count);
    copied += count;
    position += count;
  }
  return copied;
}

// Bytes of one code unit, told from the first four bytes as the parser does.
size_t StreamBlocks::CharacterBytes() const {
  unsigned char b[4];
  if (CopyFrom(0, b, 4) != 4) return 1;
  if ((b[0] == 0 && b[1] == 0 && b[2] == 0xFE && b[3] == 0xFF) ||
      (b[0] == 0xFF && b[1] == 0xFE && b[2] == 0 && b[3] == 0) ||
      (b[0] == 0 && b[1] == 0 && b[2] == 0 && b[3] == '<') ||
      (b[0] == '<' && b[1] == 0 && b[2] == 0 && b[3] == 0)) {
    return 4;
  }
  if ((b[0] == 0xFE && b[1] == 0xFF) || (b[0] == 0xFF && b[1] == 0xFE) || (b[0] == 0 && b[1] == '<') ||
      (b[0] == '<' && b[1] == 0)) {
    return 2;
  }
  return 1;
}

bool StreamBlocks::HasNulCharacter() const {
  const size_t unit = CharacterBytes();
  for (const Block& block : blocks_) {
    const char* const bytes = block.bytes.get();
    if (unit == 1) {
      if (std::memchr(bytes, 0, block.size) != nullptr) return true;
      continue;
    }
    // Every block but the last is full and as long as a multiple of four, so no character lies across two.
    static const char kNul[4] = {};
    for (size_t i = 0; i + unit <= block.size; i += unit) {
      if (std::memcmp(bytes + i, kNul, unit) == 0) return true;
    }
  }
  return false;
}

BlockInputSource::BlockInputSource(const StreamBlocks& blocks, xercesc::MemoryManager* memory)
    : InputSource(ToXMLCh(u"istream"), memory), blocks_(blocks) {}

BlockInputSource::~BlockInputSource() = default;

xercesc::BinInputStream* BlockInputSource::makeStream() const {
  return new (getMemoryManager()) BlockStream(blocks_);
}

}  // namespace MCKestrel_800
