// A stream that nothing comes out of.

#ifndef KESTREL_FUZZ_NULLSTREAM_H
#define KESTREL_FUZZ_NULLSTREAM_H

#include <ostream>
#include <streambuf>

namespace kestrel_fuzz {

/// Takes everything, so that what displays itself is formatted in full; a stream without buffer would format
/// nothing.
class NullStream : private std::streambuf, public std::ostream {
 public:
  NullStream() : std::ostream(static_cast<std::streambuf*>(this)) {}

 private:
  std::streambuf::int_type overflow(std::streambuf::int_type c) override {
    return std::streambuf::traits_type::not_eof(c);
  }
  std::streamsize xsputn(const char*, std::streamsize count) override { return count; }
};

}  // namespace kestrel_fuzz

#endif  // KESTREL_FUZZ_NULLSTREAM_H
