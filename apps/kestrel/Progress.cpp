#include "apps/kestrel/Progress.h"

#include <cmath>
#include <cstdio>

#include "kestrel/platform/Terminal.h"

namespace kestrel_program {
namespace {

/// Numbers here are for people: this many digits after the point, whatever the locale.
std::string Thousandths(double number) {
  const auto whole = static_cast<std::uint64_t>(std::llround(number * 1000.0));
  const std::string digits = std::to_string(1000 + whole % 1000);
  return std::to_string(whole / 1000) + "." + digits.substr(1);
}

std::string Rate(std::uint64_t cases, double seconds) {
  return std::to_string(seconds > 0.0 ? static_cast<std::uint64_t>(static_cast<double>(cases) / seconds)
                                      : cases);
}

}  // namespace

Progress::Progress()
    : begin_(Clock::now()), last_shown_(begin_), is_terminal_(MCKestrel_800::IsTerminal(stderr)) {}

Progress::~Progress() {
  Clear();
}

void Progress::Show() {
  const Clock::time_point now = Clock::now();
  if (now - last_shown_ < std::chrono::milliseconds(500)) return;
  last_shown_ = now;
  is_shown_ = true;
  const std::string text =
      "\r" + std::to_string(cases_) + " cases, " + Rate(cases_, GetSeconds()) + " a second ";
  std::fputs(text.c_str(), stderr);
  std::fflush(stderr);
}

void Progress::Clear() {
  if (!is_shown_) return;
  std::fputs("\r                                                  \r", stderr);
  std::fflush(stderr);
  is_shown_ = false;
}

void Progress::Say(const std::string& text) {
  Clear();
  std::fprintf(stderr, "kestrel: %s\n", text.c_str());
}

std::string Progress::Summarize() const {
  const double seconds = GetSeconds();
  return std::to_string(cases_) + (cases_ == 1 ? " case, " : " cases, ") + std::to_string(failures_) +
         " failed, " + Thousandths(seconds) + " s, " + Rate(cases_, seconds) + " cases a second";
}

}  // namespace kestrel_program
