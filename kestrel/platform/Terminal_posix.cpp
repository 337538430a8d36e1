#include <limits.h>
#include <signal.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstring>

#include "kestrel/platform/Terminal.h"

namespace MCKestrel_800 {
namespace {

constexpr int kEndingSignals[] = {SIGINT, SIGTERM, SIGHUP};

// A signal may come at any moment; the flag is set only while the path is whole.
char watched_path[PATH_MAX];
volatile sig_atomic_t is_watching = 0;

extern "C" void RemoveAndEnd(int signal_number) {
  RemoveWatchedFile();
  // The action was reset on entry, so the signal now does what it does to every program.
  raise(signal_number);
}

void Catch(int signal_number) {
  struct sigaction present {};
  // One that is ignored, as under nohup, stays ignored.
  if (sigaction(signal_number, nullptr, &present) != 0 || present.sa_handler == SIG_IGN) return;
  struct sigaction action {};
  action.sa_handler = RemoveAndEnd;
  action.sa_flags = static_cast<int>(SA_RESETHAND);
  sigaction(signal_number, &action, nullptr);
}

}  // namespace

void RemoveWatchedFile() noexcept {
  if (is_watching != 0) unlink(watched_path);
}

void PrepareStandardStreams() {
  signal(SIGPIPE, SIG_IGN);
}

std::vector<std::string> GetUtf8Arguments(int argc, const char* const* argv) {
  return argc > 1 ? std::vector<std::string>(argv + 1, argv + argc) : std::vector<std::string>();
}

bool IsTerminal(std::FILE* stream) {
  return isatty(fileno(stream)) == 1;
}

void IgnoreLibrariesOfCurrentFolder() {}

bool IsDevice(const std::string& path) {
  struct stat status {};
  if (stat(path.c_str(), &status) != 0) return false;
  return !S_ISREG(status.st_mode) && !S_ISDIR(status.st_mode);
}

std::FILE* OpenForWriting(const std::string& path) {
  return std::fopen(path.c_str(), "wb");
}

void RemoveWhenInterrupted(const std::string& path) {
  is_watching = 0;
  if (path.empty() || path.size() >= sizeof watched_path) return;
  std::memcpy(watched_path, path.c_str(), path.size() + 1);
  is_watching = 1;
  for (const int signal_number : kEndingSignals)
    Catch(signal_number);
}

}  // namespace MCKestrel_800
