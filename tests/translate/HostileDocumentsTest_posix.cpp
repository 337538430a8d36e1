// Hostile documents take little memory and reach nothing outside, watched in the ways that Linux offers.

#include <arpa/inet.h>
#include <gtest/gtest.h>
#include <netinet/in.h>
#include <sys/inotify.h>
#include <sys/resource.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "kestrel/translate/DocumentReader.h"
#include "tests/support/ExpectFault.h"
#include "tests/support/HostileDocuments.h"
#include "tests/support/TempFolder.h"

namespace {

using kestrel_tests::Bombs;
using kestrel_tests::ExpectFault;
using kestrel_tests::HostileDocument;
using kestrel_tests::OutsideReferences;
using kestrel_tests::TempFolder;
using kestrel_tests::UnusedReferences;

#if defined(__SANITIZE_ADDRESS__)
constexpr bool kSanitized = true;
#else
constexpr bool kSanitized = false;
#endif

void Read(const std::string& text) {
  std::istringstream in(text);
  MCKestrel_800::ReadDocument(in);
}

void ExpectRefused(const HostileDocument& document) {
  ExpectFault([&document] { Read(document.text); }, 6, "Invalid XML file!!", document.why);
}

// Runs `action` in a process of its own and returns the most memory that it held there beyond what it started
// with.
template <typename Action>
size_t PeakBytesOf(Action action) {
  int channel[2];
  EXPECT_EQ(pipe(channel), 0);
  const pid_t child = fork();
  if (child == 0) {
    struct rusage before = {}, after = {};
    getrusage(RUSAGE_SELF, &before);
    action();
    getrusage(RUSAGE_SELF, &after);
    const size_t peak = static_cast<size_t>(after.ru_maxrss - before.ru_maxrss) * 1024;
    const ssize_t written = write(channel[1], &peak, sizeof(peak));
    _exit(written == sizeof(peak) ? 0 : 1);
  }
  close(channel[1]);
  size_t peak = 0;
  EXPECT_EQ(read(channel[0], &peak, sizeof(peak)), static_cast<ssize_t>(sizeof(peak)));
  close(channel[0]);
  int status = 0;
  EXPECT_EQ(waitpid(child, &status, 0), child);
  EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0);
  return peak;
}

TEST(HostileDocuments, BombsTakeLittleMemory) {
  if (kSanitized) GTEST_SKIP() << "the sanitizer's own memory would count";
  for (const HostileDocument& document : Bombs()) {
    const size_t peak = PeakBytesOf([&document] {
      try {
        Read(document.text);
      } catch (const MCKestrel_800::KestrelException&) {
      }
    });
    EXPECT_LT(peak, size_t{200} << 20) << document.why;
  }
}

// Sees every file that is opened in a folder.
class FolderWatch {
 public:
  explicit FolderWatch(const std::string& folder) : watch_(inotify_init1(IN_NONBLOCK)) {
    EXPECT_GE(inotify_add_watch(watch_, folder.c_str(), IN_OPEN | IN_ACCESS), 0);
  }
  ~FolderWatch() { close(watch_); }
  FolderWatch(const FolderWatch&) = delete;
  FolderWatch& operator=(const FolderWatch&) = delete;
  bool SawAccess() {
    char events[4096];
    return read(watch_, events, sizeof(events)) > 0;
  }

 private:
  int watch_;
};

// Listens on a port of this machine.
class Listener {
 public:
  Listener() : socket_(socket(AF_INET, SOCK_STREAM | SOCK_NONBLOCK, 0)) {
    sockaddr_in address = {};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    EXPECT_EQ(bind(socket_, reinterpret_cast<sockaddr*>(&address), sizeof(address)), 0);
    EXPECT_EQ(listen(socket_, 8), 0);
    socklen_t length = sizeof(address);
    EXPECT_EQ(getsockname(socket_, reinterpret_cast<sockaddr*>(&address), &length), 0);
    port_ = ntohs(address.sin_port);
  }
  ~Listener() { close(socket_); }
  Listener(const Listener&) = delete;
  Listener& operator=(const Listener&) = delete;
  std::string GetAddress(const std::string& scheme) const {
    return scheme + "://127.0.0.1:" + std::to_string(port_) + "/secret";
  }
  bool SawConnection() { return accept(socket_, nullptr, nullptr) >= 0; }

 private:
  int socket_;
  int port_ = 0;
};

// A folder with a secret file and a pipe that nobody writes to, as the current folder; everything in it is
// watched.
class OutsideTest : public testing::Test {
 protected:
  void SetUp() override {
    previous_ = std::filesystem::current_path();
    folder_.Write("secret", "<!ENTITY z 'secret'>");
    ASSERT_EQ(mkfifo(folder_.PathOf("pipe").c_str(), 0600), 0);
    std::filesystem::current_path(folder_.GetPath());
    watch_.reset(new FolderWatch(folder_.GetPath().string()));
    alarm(120);  // whoever opens the pipe waits for ever
  }
  void TearDown() override {
    alarm(0);
    std::filesystem::current_path(previous_);
  }
  std::vector<std::string> Targets() const {
    return {"file://" + folder_.PathOf("secret"),
            "file://localhost" + folder_.PathOf("secret"),
            folder_.PathOf("secret"),
            "secret",
            "./secret",
            "file://" + folder_.PathOf("pipe"),
            folder_.PathOf("pipe"),
            "pipe",
            listener_.GetAddress("http"),
            listener_.GetAddress("https"),
            listener_.GetAddress("ftp")};
  }
  void ExpectNothingReached(const std::string& why) {
    EXPECT_FALSE(watch_->SawAccess()) << why;
    EXPECT_FALSE(listener_.SawConnection()) << why;
  }

  TempFolder folder_;
  Listener listener_;
  std::unique_ptr<FolderWatch> watch_;
  std::filesystem::path previous_;
};

TEST_F(OutsideTest, WatchSeesAnOpenedFile) {
  EXPECT_EQ(std::filesystem::file_size("secret"), 20u);
  std::ifstream in("secret");
  in.get();
  EXPECT_TRUE(watch_->SawAccess());
}

TEST_F(OutsideTest, UsedReferencesAreRefusedUnread) {
  for (const std::string& target : Targets()) {
    for (const HostileDocument& document : OutsideReferences(target)) {
      ExpectRefused(document);
      ExpectNothingReached(document.why);
    }
  }
}

TEST_F(OutsideTest, UnusedReferencesAreIgnoredUnread) {
  for (const std::string& target : Targets()) {
    for (const HostileDocument& document : UnusedReferences(target)) {
      EXPECT_NO_THROW(Read(document.text)) << document.why;
      ExpectNothingReached(document.why);
    }
  }
}

}  // namespace
