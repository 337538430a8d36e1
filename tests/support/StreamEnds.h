// Open file descriptors and pipes for the streams of programs that tests run.

#ifndef KESTREL_TESTS_SUPPORT_STREAMENDS_H
#define KESTREL_TESTS_SUPPORT_STREAMENDS_H

#include <fcntl.h>
#include <gtest/gtest.h>

#include <string>
#include <utility>
#if defined(_WIN32)
#include <io.h>
#else
#include <unistd.h>
#endif

namespace kestrel_tests {

/// A file descriptor that is closed in the end.
class Descriptor {
 public:
  explicit Descriptor(int number) : number_(number) { EXPECT_NE(number, -1); }
  ~Descriptor() { Close(); }
  Descriptor(Descriptor&& other) noexcept : number_(std::exchange(other.number_, -1)) {}
  Descriptor(const Descriptor&) = delete;
  Descriptor& operator=(const Descriptor&) = delete;

  int Get() const { return number_; }
  void Close() {
    if (number_ != -1) close(number_);
    number_ = -1;
  }

  /// Writes the whole text; waits where the other side is slow.
  void Write(const std::string& text) const {
    for (std::size_t done = 0; done < text.size();) {
      const auto written = write(number_, text.data() + done, static_cast<unsigned>(text.size() - done));
      ASSERT_GT(written, 0);
      done += static_cast<std::size_t>(written);
    }
  }

 private:
  int number_;
};

struct Pipe {
  Descriptor reader;
  Descriptor writer;
};

/// A child gets the end that it is handed as a stream and no other: it would never see the end of its input
/// if it held the writing end too.
inline Pipe MakePipe() {
  int ends[2] = {-1, -1};
#if defined(_WIN32)
  EXPECT_EQ(_pipe(ends, 64 * 1024, _O_BINARY | _O_NOINHERIT), 0);
#else
  EXPECT_EQ(pipe(ends), 0);
  for (const int end : ends)
    EXPECT_EQ(fcntl(end, F_SETFD, FD_CLOEXEC), 0);
#endif
  return {Descriptor(ends[0]), Descriptor(ends[1])};
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_SUPPORT_STREAMENDS_H
