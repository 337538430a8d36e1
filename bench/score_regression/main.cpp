// What one case costs: a regression on 20 numeric inputs, filling the record included.
//
// With `--cases N --missing M` the program scores N cases and stops, for counting instructions from outside.

#include <benchmark/benchmark.h>

#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <new>
#include <sstream>
#include <vector>

#include "bench/support/Documents.h"
#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/model/Results.h"
#include "kestrel/model/ScoreModel.h"

namespace {
size_t allocations = 0;
}  // namespace

// Counts every allocation of the program, the library and the plug-in.
[[gnu::noinline]] void* operator new(size_t size) {
  ++allocations;
  if (void* memory = std::malloc(size)) return memory;
  throw std::bad_alloc();
}
[[gnu::noinline]] void operator delete(void* memory) noexcept {
  std::free(memory);
}
[[gnu::noinline]] void operator delete(void* memory, size_t) noexcept {
  std::free(memory);
}

namespace kestrel_bench {
namespace {

using namespace MCKestrel_800;

constexpr int kInputs = 20;
constexpr size_t kRows = 256;

/// A model with its record and result, and the cases' numbers; every fourth input is missing when wanted.
class Scorer {
 public:
  explicit Scorer(int missing) : record_(kInputs) {
    std::istringstream in(LinearModel(kInputs, true));
    model_.reset(ModelFactory::MakeModelFromXML(in, {"RegressionModel"}, std::string()));
    result_.reset(model_->MakeResult());
    for (int i = 0; i < kInputs; ++i) {
      record_.Add("x" + std::to_string(i), new NumericValue());
      (i % 4 == 1 && i / 4 < missing ? missing_ : present_).push_back(i);
      for (size_t row = 0; row < kRows; ++row)
        rows_[row][i] = static_cast<double>((row + static_cast<size_t>(i)) & 255);
    }
    Score(0);
    Check();
  }

  /// Fills the record as a host does that has its numbers in rows, and scores it.
  double Score(size_t number) {
    const double* const row = rows_[number % kRows];
    if (missing_.empty()) {
      for (int i = 0; i < kInputs; ++i)
        record_.SetValue(i, row[i]);
    } else {
      FillWithMissing(row);
    }
    if (!model_->Score(&record_, result_.get()).IsOK()) std::abort();
    return result_->GetPrediction()->GetDouble();
  }

 private:
  void FillWithMissing(const double* row) {
    for (const int i : present_)
      record_.SetValue(i, row[i]);
    for (const int i : missing_)
      record_.SetMissingValue(i);
  }

  /// A wrong answer's time is worth nothing.
  void Check() {
    double expected = 0.25;
    for (const int i : present_)
      expected += rows_[0][i] * (0.5 + i / 8.0);
    for (const int i : missing_)
      expected += 0.5 + i / 8.0;
    if (std::abs(Score(0) - expected) > 1e-12 * expected) {
      std::fprintf(stderr, "bench_score_regression: wrong answer\n");
      std::exit(1);
    }
  }

  CaseRecord record_;
  std::unique_ptr<ScoreModel> model_;
  std::unique_ptr<ScoreResult> result_;
  std::vector<int> present_, missing_;
  double rows_[kRows][kInputs];
};

void ScoreCases(benchmark::State& state) {
  Scorer scorer(static_cast<int>(state.range(0)));
  size_t number = 0;
  const size_t before = allocations;
  for (auto _ : state)
    benchmark::DoNotOptimize(scorer.Score(number++));
  // The benchmark library allocates a few times of its own between its rounds, whatever the number of cases.
  state.counters["allocations_per_case"] =
      std::floor(1000.0 * static_cast<double>(allocations - before) / static_cast<double>(number)) / 1000.0;
  state.SetItemsProcessed(static_cast<int64_t>(number));
}
BENCHMARK(ScoreCases)->Name("regression_20_inputs")->ArgName("missing")->Arg(0)->Arg(5);

}  // namespace
}  // namespace kestrel_bench

int main(int argc, char** argv) {
  if (argc == 5 && std::strcmp(argv[1], "--cases") == 0) {
    kestrel_bench::Scorer scorer(std::atoi(argv[4]));
    const long cases = std::atol(argv[2]);
    double sum = 0.0;
    for (long i = 0; i < cases; ++i)
      sum += scorer.Score(static_cast<size_t>(i));
    std::printf("%.17g\n", sum);
    return 0;
  }
  benchmark::Initialize(&argc, argv);
  benchmark::RunSpecifiedBenchmarks();
  benchmark::Shutdown();
  return 0;
}
