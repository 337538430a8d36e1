// Compares contestants in one run: rounds of one turn each, so that a slow moment of the machine hits all
// alike.

#ifndef KESTREL_BENCH_SUPPORT_INTERLEAVED_H
#define KESTREL_BENCH_SUPPORT_INTERLEAVED_H

#include <sys/resource.h>

#include <algorithm>
#include <cstdio>
#include <functional>
#include <string>
#include <vector>

namespace kestrel_bench {

/// User and system time of this process so far, in seconds.
inline double ProcessorSeconds() {
  rusage usage{};
  getrusage(RUSAGE_SELF, &usage);
  const auto seconds = [](const timeval& t) {
    return static_cast<double>(t.tv_sec) + 1e-6 * static_cast<double>(t.tv_usec);
  };
  return seconds(usage.ru_utime) + seconds(usage.ru_stime);
}

/// One side of a comparison. A turn does the work `repeat` times and returns when what is timed is over;
/// `after` cleans up outside the time.
struct Contestant {
  std::string name;
  std::function<void()> turn;
  std::function<void()> after = [] {};
};

inline double Median(std::vector<double> values) {
  std::sort(values.begin(), values.end());
  return values[values.size() / 2];
}

/// What a machine that does other things as well did when it did the least of them.
inline double Least(std::vector<double> values) {
  return *std::min_element(values.begin(), values.end());
}

/// Seconds of one turn of each contestant: the median over the rounds, or what else `summary` makes of them,
/// after one round that does not count.
inline std::vector<double> Compare(const std::vector<Contestant>& contestants, int rounds = 5,
                                   double (*summary)(std::vector<double>) = Median) {
  std::vector<std::vector<double>> seconds(contestants.size());
  for (int round = -1; round < rounds; ++round) {
    for (size_t i = 0; i < contestants.size(); ++i) {
      const double start = ProcessorSeconds();
      contestants[i].turn();
      const double spent = ProcessorSeconds() - start;
      contestants[i].after();
      if (round >= 0) seconds[i].push_back(spent);
    }
  }
  std::vector<double> summaries;
  for (const auto& one : seconds)
    summaries.push_back(summary(one));
  return summaries;
}

/// Prints each contestant's time and its ratio to the first, the baseline.
inline void PrintRatios(const std::vector<Contestant>& contestants, const std::vector<double>& seconds) {
  for (size_t i = 0; i < contestants.size(); ++i) {
    std::printf("  %-46s %10.6f s  %6.2f x\n", contestants[i].name.c_str(), seconds[i],
                seconds[i] / seconds[0]);
  }
}

}  // namespace kestrel_bench

#endif  // KESTREL_BENCH_SUPPORT_INTERLEAVED_H
