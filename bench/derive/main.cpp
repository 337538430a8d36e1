// What the derived values of one case cost: 200 derived fields of 30 inputs, beside the same values computed
// by hand; and what the number of rows and bins adds.
//
// With `--cases N ROAD` the program computes N cases on one road (plain, record, texts) and stops, for
// counting instructions from outside.

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <random>
#include <string>
#include <unordered_map>
#include <vector>

#include "bench/support/CountAllocations.h"
#include "kestrel/dictionary/BaseDictionary.h"
#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/dictionary/DictVar.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/predicates/Range.h"
#include "kestrel/transform/FunctionTreeImp.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/transform/TransformationDictionary.h"
#include "kestrel/transform/ValueMatcher.h"

namespace kestrel_bench {
namespace {

using namespace MCKestrel_800;

constexpr int kNumbers = 20;
constexpr int kTexts = 10;
constexpr int kOfEachKind = 50;
constexpr int kPoints = 8;
constexpr int kBins = 8;
constexpr int kCategories = 20;
constexpr size_t kRows = 4'096;

[[noreturn]] void Fail(const char* what) {
  std::fprintf(stderr, "bench_derive: %s\n", what);
  std::exit(1);
}

std::string NumberName(int i) {
  return "x" + std::to_string(i % kNumbers);
}
std::string TextName(int i) {
  return "t" + std::to_string(i % kTexts);
}
std::string Category(int i) {
  return "category" + std::to_string(i);
}

/// The definitions, as numbers that both roads use.
struct Definitions {
  std::vector<double> norms[kOfEachKind];
  double factors[kOfEachKind];
  double offsets[kOfEachKind];

  Definitions() {
    std::mt19937 random(11);
    const auto draw = [&random] { return static_cast<double>(random()) / 4294967296.0; };
    for (int i = 0; i < kOfEachKind; ++i) {
      for (int point = 0; point < kPoints; ++point)
        norms[i].push_back(draw());
      factors[i] = draw();
      offsets[i] = draw();
    }
  }
  static double Orig(int point) { return point / static_cast<double>(kPoints - 1); }
  static double Margin(int bin) { return bin / static_cast<double>(kBins); }
  static double Code(int field, int row) { return (field + row) % 7; }
  static std::string Label(int field, int row) { return "label" + std::to_string((field + row) % 7); }
};

ApplyNodeStats Field(const std::string& name) {
  ApplyNodeStats stats;
  stats.SetParameterName(name);
  return stats;
}

ApplyNodeStats Constant(double number) {
  ApplyNodeStats stats;
  stats.SetConstNode(true);
  stats.SetValue(new NumericValue(number));
  return stats;
}

FunctionTree* Call(TransformFunction function, FunctionTree* x, FunctionTree* y) {
  ApplyNodeStats stats;
  stats.SetTransFunction(function);
  auto* node = new FunctionTreeImp(stats);
  node->Add(x);
  node->Add(y);
  return node;
}

FunctionTree* Leaf(const ApplyNodeStats& stats) {
  return new FunctionTreeImp(stats);
}

class Derivation {
 public:
  /// with_texts  makes every second binned or mapped field a text.
  explicit Derivation(bool with_texts) : with_texts_(with_texts), record_(kNumbers + kTexts) {
    for (int i = 0; i < kNumbers; ++i)
      data_.AddVar(NumberName(i), new DictVar(NumberName(i), ScoreDictVar::kNUMERIC_VAR));
    for (int i = 0; i < kTexts; ++i)
      data_.AddVar(TextName(i), new DictVar(TextName(i), ScoreDictVar::STRING_VAR));
    for (int i = 0; i < kOfEachKind; ++i) {
      AddNorm(i);
      AddBins(i);
      AddMap(i);
      AddApply(i);
    }
    derived_.SetUpDerivedCaseRecord();
    MakeRows();
    for (int i = 0; i < kNumbers; ++i)
      record_.Add(NumberName(i), new NumericValue());
    for (int i = 0; i < kTexts; ++i)
      record_.Add(TextName(i), new StringValue());
    for (int i = 0; i < kCategories; ++i)
      categories_.emplace(Category(i), i);
    Check();
  }

  /// Numbers in place of texts: the hand does not write labels, and looks a category up once.
  void ComputePlain(size_t number) {
    const double* const x = &numbers_[number % kRows * kNumbers];
    const int* const t = &texts_[number % kRows * kTexts];
    int codes[kTexts];
    for (int i = 0; i < kTexts; ++i)
      codes[i] = categories_.find(category_names_[t[i]])->second;
    for (int i = 0; i < kOfEachKind; ++i) {
      const double value = x[i % kNumbers];
      const int segment = std::min(static_cast<int>(value * (kPoints - 1)), kPoints - 2);
      const double* const norm = &definitions_.norms[i][segment];
      const double part = value * (kPoints - 1) - segment;
      plain_[4 * i] = norm[0] + (norm[1] - norm[0]) * part;
      plain_[4 * i + 1] = Definitions::Code(i, static_cast<int>(value * kBins));
      plain_[4 * i + 2] = Definitions::Code(i, codes[i % kTexts]);
      plain_[4 * i + 3] = value * definitions_.factors[i] + (x[(i + 1) % kNumbers] - definitions_.offsets[i]);
    }
  }

  /// As a host does it: fills the record, has the values computed.
  const CaseRecord* ComputeRecord(size_t number) {
    const double* const x = &numbers_[number % kRows * kNumbers];
    const int* const t = &texts_[number % kRows * kTexts];
    for (int i = 0; i < kNumbers; ++i)
      record_.SetValue(i, x[i]);
    for (int i = 0; i < kTexts; ++i)
      record_.SetValue(kNumbers + i, category_names_[t[i]]);
    return derived_.GetValuesForDerivedVars(&record_, &data_);
  }

 private:
  void Add(TransformVar* field) {
    derived_.AddVar(field->GetName(), field);
    derived_.AddDerievedVarName(field->GetName());
  }

  ScoreDictVar::VariableType TypeOf(int i) const {
    return i % 2 == 0 || !with_texts_ ? ScoreDictVar::kNUMERIC_VAR : ScoreDictVar::STRING_VAR;
  }

  ScoreValue* Result(int field, int row) const {
    if (TypeOf(field) == ScoreDictVar::STRING_VAR) return new StringValue(Definitions::Label(field, row));
    return new NumericValue(Definitions::Code(field, row));
  }

  void AddNorm(int i) {
    auto* field = new TransformVar("norm" + std::to_string(i), ScoreDictVar::kNUMERIC_VAR);
    field->AddFieldNameAndTransExpression(NumberName(i), TransExpression::kNormContinuous);
    const std::vector<double>& norm = definitions_.norms[i];
    for (int point = 0; point < kPoints; ++point) {
      field->AddLinearNorm(Definitions::Orig(point), norm[point]);
      if (point == 0) continue;
      const double left = Definitions::Orig(point - 1), right = Definitions::Orig(point);
      field->AddNormInfo((norm[point] - norm[point - 1]) / (right - left),
                         (norm[point - 1] * right - left * norm[point]) / (right - left));
    }
    Add(field);
  }

  void AddBins(int i) {
    auto* field = new TransformVar("bin" + std::to_string(i), TypeOf(i));
    field->AddFieldNameAndTransExpression(NumberName(i), TransExpression::kDiscretize);
    for (int bin = 0; bin < kBins; ++bin) {
      field->AddBinningValue(new Range(Definitions::Margin(bin), Definitions::Margin(bin + 1), true, false),
                             Result(i, bin));
    }
    Add(field);
  }

  void AddMap(int i) {
    auto* field = new TransformVar("map" + std::to_string(i), TypeOf(i));
    field->AddFieldNameAndTransExpression(TextName(i), TransExpression::kMapValues);
    for (int row = 0; row < kCategories; ++row)
      field->AddEncodingMap(new ValueMatcher(new StringValue(Category(row))), Result(i, row));
    Add(field);
  }

  void AddApply(int i) {
    auto* field = new TransformVar("apply" + std::to_string(i), ScoreDictVar::kNUMERIC_VAR);
    field->AddFieldNameAndTransExpression(std::string(), TransExpression::kApply);
    field->SetRoot(
        Call(kPlusFunction,
             Call(kMultiplyFunction, Leaf(Field(NumberName(i))), Leaf(Constant(definitions_.factors[i]))),
             Call(kMinusFunction, Leaf(Field(NumberName(i + 1))), Leaf(Constant(definitions_.offsets[i])))));
    Add(field);
  }

  void MakeRows() {
    std::mt19937 random(7);
    for (size_t i = 0; i < kRows * kNumbers; ++i)
      numbers_.push_back(static_cast<double>(random()) / 4294967296.0);
    for (size_t i = 0; i < kRows * kTexts; ++i)
      texts_.push_back(static_cast<int>(random() % kCategories));
    for (int i = 0; i < kCategories; ++i)
      category_names_.push_back(Category(i));
  }

  /// A wrong answer's time is worth nothing.
  void Check() {
    for (size_t row = 0; row < kRows; ++row) {
      ComputePlain(row);
      const std::vector<ScoreValue*>& values = ComputeRecord(row)->GetAllValues();
      for (size_t i = 0; i < values.size(); ++i) {
        if (values[i]->GetType() == ScoreValue::kString) {
          if (values[i]->GetString() != Definitions::Label(0, static_cast<int>(plain_[i])))
            Fail("wrong text");
        } else if (std::abs(values[i]->GetDouble() - plain_[i]) > 1e-12) {
          Fail("wrong number");
        }
      }
    }
  }

  bool with_texts_;
  Definitions definitions_;
  BaseDictionary data_;
  TransformationDictionary derived_;
  CaseRecord record_;
  std::vector<double> numbers_;
  std::vector<int> texts_;
  std::vector<std::string> category_names_;
  std::unordered_map<std::string, int> categories_;

 public:
  double plain_[4 * kOfEachKind];
};

void ByHand(benchmark::State& state) {
  Derivation derivation(false);
  size_t number = 0;
  for (auto _ : state) {
    derivation.ComputePlain(number++);
    benchmark::DoNotOptimize(derivation.plain_);
    benchmark::ClobberMemory();
  }
}
BENCHMARK(ByHand)->Name("derive200/by_hand");

void PerCase(benchmark::State& state, bool with_texts) {
  Derivation derivation(with_texts);
  size_t number = 0;
  const size_t before = allocations;
  for (auto _ : state)
    benchmark::DoNotOptimize(derivation.ComputeRecord(number++));
  state.counters["allocations_per_case"] = AllocationsPerCase(before, number);
}
BENCHMARK_CAPTURE(PerCase, numbers, false)->Name("derive200/record");
BENCHMARK_CAPTURE(PerCase, texts, true)->Name("derive200/record_with_50_texts");

/// One field with many rows: categories of a text or of a number, or bins.
enum Rows { kTextRows, kNumberRows, kBinRows };

void ManyRows(benchmark::State& state, Rows kind) {
  const int rows = static_cast<int>(state.range(0));
  BaseDictionary data;
  const bool is_text = kind == kTextRows;
  data.AddVar("x", new DictVar("x", is_text ? ScoreDictVar::STRING_VAR : ScoreDictVar::kNUMERIC_VAR));
  TransformationDictionary derived;
  auto* field = new TransformVar("y", ScoreDictVar::kNUMERIC_VAR);
  field->AddFieldNameAndTransExpression(
      "x", kind == kBinRows ? TransExpression::kDiscretize : TransExpression::kMapValues);
  for (int row = 0; row < rows; ++row) {
    if (kind == kBinRows) {
      field->AddBinningValue(new Range(row, row + 1, true, false), new NumericValue(row));
    } else {
      field->AddEncodingMap(
          new ValueMatcher(is_text ? static_cast<ScoreValue*>(new StringValue(Category(row)))
                                   : new NumericValue(row)),
          new NumericValue(row));
    }
  }
  derived.AddVar("y", field);
  derived.AddDerievedVarName("y");
  derived.SetUpDerivedCaseRecord();
  std::vector<std::unique_ptr<CaseRecord>> cases;
  std::mt19937 random(3);
  for (int i = 0; i < 1024; ++i) {
    const int row = static_cast<int>(random() % static_cast<unsigned>(rows));
    cases.push_back(std::make_unique<CaseRecord>(1));
    cases.back()->Add(
        "x", is_text ? static_cast<ScoreValue*>(new StringValue(Category(row))) : new NumericValue(row));
    if (derived.GetValuesForDerivedVars(cases.back().get(), &data)->Get(0)->GetDouble() != row)
      Fail("wrong row");
  }
  // One record that changes, as hosts have it.
  CaseRecord record(*cases.front());
  size_t number = 0;
  for (auto _ : state) {
    const ScoreValue* value = cases[number++ % cases.size()]->Get(0);
    if (is_text) {
      record.SetValue(0, static_cast<const StringValue*>(value)->GetText());
    } else {
      record.SetValue(0, value->GetDouble());
    }
    benchmark::DoNotOptimize(derived.GetValuesForDerivedVars(&record, &data));
  }
}
BENCHMARK_CAPTURE(ManyRows, map_texts, kTextRows)->Arg(10)->Arg(10'000);
BENCHMARK_CAPTURE(ManyRows, map_numbers, kNumberRows)->Arg(10)->Arg(10'000);
BENCHMARK_CAPTURE(ManyRows, bins, kBinRows)->Arg(10)->Arg(10'000);

int ComputeCases(size_t cases, const char* road) {
  Derivation derivation(std::strcmp(road, "texts") == 0);
  double sum = 0.0;
  for (size_t number = 0; number < cases; ++number) {
    if (std::strcmp(road, "plain") == 0) {
      derivation.ComputePlain(number);
      sum += derivation.plain_[0];
    } else {
      sum += derivation.ComputeRecord(number)->Get(0)->GetDouble();
    }
  }
  std::printf("%g\n", sum);
  return 0;
}

}  // namespace
}  // namespace kestrel_bench

int main(int argc, char** argv) {
  if (argc == 4 && std::strcmp(argv[1], "--cases") == 0) {
    return kestrel_bench::ComputeCases(std::strtoull(argv[2], nullptr, 10), argv[3]);
  }
  benchmark::Initialize(&argc, argv);
  if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
  benchmark::RunSpecifiedBenchmarks();
  return 0;
}
