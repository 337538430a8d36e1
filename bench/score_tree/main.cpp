// What one case costs in a tree of depth 12 on 30 numeric inputs, and what one predicate costs, beside a walk
// by hand of the same tree.
//
// With `--cases N ROAD` the program scores N cases on one road (plain, vector, record) and stops, for
// counting instructions from outside.

#include <benchmark/benchmark.h>

#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <random>
#include <sstream>
#include <string>
#include <vector>

#include "bench/support/CountAllocations.h"
#include "bench/support/TreeDocuments.h"
#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/model/Results.h"
#include "kestrel/predicates/CompoundPredicate.h"
#include "kestrel/predicates/Range.h"
#include "kestrel/predicates/ScaleSplit.h"
#include "kestrel/predicates/SimplePredicate.h"
#include "kestrel/translate/DocumentReader.h"
#include "plugins/tree/TreeModel.h"
#include "plugins/tree/TreeTranslator.h"

namespace kestrel_bench {
namespace {

using namespace MCKestrel_800;

constexpr int kInputs = 30;
constexpr int kDepth = 12;
/// So many that nothing learns the cases by heart.
constexpr size_t kRows = 16'384;

[[noreturn]] void Fail(const char* what) {
  std::fprintf(stderr, "bench_score_tree: %s\n", what);
  std::exit(1);
}

/// A tree by hand and as a model, and cases; one value in ten is missing when wanted.
class Trees {
 public:
  Trees(int categories, bool with_missing)
      : categories_(categories), plain_(RandomTree(kInputs, kDepth, 20)), record_(kInputs) {
    TreeShape shape;
    shape.categories = categories;
    shape.default_child = with_missing;
    std::istringstream in(TreeDocument(plain_, kInputs, shape));
    const auto tree = ReadDocument(in);
    TreeTranslator translator;
    model_.reset(static_cast<TreeModel*>(translator.ParseFromTree(tree->GetRoot(), std::string())));
    result_.reset(model_->MakeResult());
    FindSlots();
    MakeRows(with_missing);
    for (int i = 0; i < kInputs; ++i)
      record_.Add("x" + std::to_string(i), new NumericValue());
    if (!with_missing) Check();
  }

  double ScorePlain(size_t number) const { return plain_.Score(&rows_[number % kRows * kInputs]); }

  /// The vector road: the values lie ready by slot.
  double ScoreVector(size_t number) {
    model_->ScoreVector(&vectors_[number % kRows * kInputs], result_.get());
    return Answer();
  }

  /// The per-case road, as a host takes it: fills the record, scores, reads the prediction.
  double ScoreRecord(size_t number) {
    const double* const row = &rows_[number % kRows * kInputs];
    for (int i = 0; i < kInputs; ++i)
      record_.SetValue(i, row[i]);
    model_->Score(&record_, result_.get());
    return Answer();
  }

 private:
  double Answer() const {
    if (categories_ == 0) return result_->GetPrediction()->GetDouble();
    return static_cast<const StringValue*>(result_->GetPrediction())->GetText().back() - '0';
  }

  void FindSlots() {
    for (int i = 0; i < kInputs; ++i) {
      const ScoreDictVar* variable = model_->GetDictionary()->GetVar("x" + std::to_string(i));
      slots_.push_back(variable->GetEncodedValueIndex());
      if (slots_.back() < 0) Fail("an input that no node reads");
    }
  }

  void MakeRows(bool with_missing) {
    std::mt19937 random(7);
    rows_.resize(kRows * kInputs);
    vectors_.resize(kRows * kInputs);
    for (size_t i = 0; i < rows_.size(); ++i) {
      rows_[i] = static_cast<double>(random()) / 4294967296.0;
      if (with_missing && random() % 10 == 0) rows_[i] = NumericValue::gSysmisValue;
      vectors_[i / kInputs * kInputs + static_cast<size_t>(slots_[i % kInputs])] = rows_[i];
    }
  }

  /// A wrong answer's time is worth nothing.
  void Check() {
    for (size_t row = 0; row < kRows; ++row) {
      double wanted = ScorePlain(row);
      if (categories_ > 0) wanted = CategoryOf(wanted, categories_);
      if (ScoreVector(row) != wanted || ScoreRecord(row) != wanted) Fail("wrong answer");
    }
  }

  int categories_;
  PlainTree plain_;
  CaseRecord record_;
  std::unique_ptr<TreeModel> model_;
  std::unique_ptr<ScoreResult> result_;
  std::vector<int> slots_;
  std::vector<double> rows_, vectors_;
};

using Road = double (*)(Trees&, size_t);

double Plain(Trees& trees, size_t number) {
  return trees.ScorePlain(number);
}
double Vector(Trees& trees, size_t number) {
  return trees.ScoreVector(number);
}
double Record(Trees& trees, size_t number) {
  return trees.ScoreRecord(number);
}

void ScoreCases(benchmark::State& state, Road road, int categories, bool with_missing) {
  Trees trees(categories, with_missing);
  size_t number = 0;
  const size_t before = allocations;
  for (auto _ : state)
    benchmark::DoNotOptimize(road(trees, number++));
  state.counters["allocations_per_case"] = AllocationsPerCase(before, number);
}
BENCHMARK_CAPTURE(ScoreCases, by_hand, Plain, 0, false);
BENCHMARK_CAPTURE(ScoreCases, vector, Vector, 0, false);
BENCHMARK_CAPTURE(ScoreCases, record, Record, 0, false);
BENCHMARK_CAPTURE(ScoreCases, vector_3_categories, Vector, 3, false);
BENCHMARK_CAPTURE(ScoreCases, record_3_categories, Record, 3, false);
BENCHMARK_CAPTURE(ScoreCases, vector_a_tenth_missing, Vector, 0, true);
BENCHMARK_CAPTURE(ScoreCases, record_a_tenth_missing, Record, 0, true);

/// x <= 0.5, or as many such predicates joined by `and` as wanted, on the vector road.
void EvaluatePredicate(benchmark::State& state) {
  const auto children = static_cast<int>(state.range(0));
  DictVar variable("x", ScoreDictVar::kNUMERIC_VAR);
  variable.SetEncodedValueIndex(0);
  CompoundPredicate compound(ScorePredicate::kAnd);
  for (int i = 0; i < children; ++i) {
    auto split = std::make_unique<ScaleSplit>(&variable);
    split->PutSplit(new Range(-NumericValue::gInfinity, 0.5, false, true), 0);
    compound.AddPredicate(new SimplePredicate(split.release()));
  }
  ScorePredicate* const predicate = children == 1 ? compound.GetPredicates()[0] : &compound;
  std::mt19937 random(7);
  std::vector<std::vector<double>> values;
  for (size_t row = 0; row < 1024; ++row)
    values.push_back({static_cast<double>(random()) / 8589934592.0});
  size_t number = 0;
  const size_t before = allocations;
  for (auto _ : state)
    benchmark::DoNotOptimize(predicate->Evaluate(values[number++ % 1024]));
  state.counters["allocations_per_case"] = AllocationsPerCase(before, number);
}
BENCHMARK(EvaluatePredicate)->ArgName("children")->Arg(1)->Arg(64);

int RunCases(const char* count, const char* road) {
  Trees trees(0, false);
  const Road run = std::strcmp(road, "plain") == 0    ? Plain
                   : std::strcmp(road, "vector") == 0 ? Vector
                                                      : Record;
  const long cases = std::atol(count);
  double sum = 0.0;
  for (long i = 0; i < cases; ++i)
    sum += run(trees, static_cast<size_t>(i));
  std::printf("%.17g\n", sum);
  return 0;
}

}  // namespace
}  // namespace kestrel_bench

int main(int argc, char** argv) {
  if (argc == 4 && std::strcmp(argv[1], "--cases") == 0) return kestrel_bench::RunCases(argv[2], argv[3]);
  benchmark::Initialize(&argc, argv);
  benchmark::RunSpecifiedBenchmarks();
  benchmark::Shutdown();
  return 0;
}
