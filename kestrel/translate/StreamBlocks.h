// Takes in everything that a host's stream holds, whatever the stream does, before the parser sees any of it.

#ifndef KESTREL_TRANSLATE_STREAMBLOCKS_H
#define KESTREL_TRANSLATE_STREAMBLOCKS_H

#include <cstddef>
#include <iosfwd>
#include <memory>
#include <vector>
#include <xercesc/sax/InputSource.hpp>
#include <xercesc/util/BinInputStream.hpp>

namespace MCKestrel_800 {

/// The bytes of a stream, in blocks, so that a large document is neither copied while it grows nor asked for
/// its size: pipes have none, and what a directory gives is nonsense.
class StreamBlocks {
 public:
  enum class Outcome { kComplete, kFailed, kTooLarge };

  /// Reads until the stream ends. The stream's exception mask does not count meanwhile and is set again
  /// afterwards; a state that the mask would throw on is cleared, since the host asked for exceptions and
  /// gets ours.
  Outcome Read(std::istream& in, size_t maxBytes);

  size_t GetSize() const { return size_; }
  /// Whether the text holds the character NUL, which the parser takes for the end when it comes after the
  /// root element.
  bool HasNulCharacter() const;
  /// A place in the text, both counted from 1 in characters; 0 when there is none.
  struct Place {
    size_t line = 0;
    size_t column = 0;
  };
  /// The first character that is no UTF-8: not a whole sequence, longer than need be, half a surrogate pair
  /// or past U+10FFFF. The parser decodes far ahead of where it reads and tells only the latter place.
  Place FindMalformedUtf8() const;
  /// Copies up to `max` bytes from `position` on and returns their number.
  size_t CopyFrom(size_t position, unsigned char* to, size_t max) const;

 private:
  struct Block {
    std::unique_ptr<char[]> bytes;
    size_t start;
    size_t size;
  };
  Outcome ReadBlocks(std::istream& in, size_t maxBytes);
  size_t CharacterBytes() const;

  std::vector<Block> blocks_;
  size_t size_ = 0;
};

/// Feeds the parser from blocks, which must outlive it.
class BlockInputSource final : public xercesc::InputSource {
 public:
  BlockInputSource(const StreamBlocks& blocks, xercesc::MemoryManager* memory);
  ~BlockInputSource() override;
  xercesc::BinInputStream* makeStream() const override;

 private:
  const StreamBlocks& blocks_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_STREAMBLOCKS_H
