#include "tests/math/ReferenceFunctions.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <limits>
#include <sstream>
#include <stdexcept>

#include "kestrel/foundation/MCMV.h"
#include "kestrel/math/MCDistFun.h"
#include "tests/support/PlainTable.h"

namespace kestrel_tests {
namespace {

using MCMath_800::MCDistFun;

constexpr AccuracyGoal kCentral = {2e-15, 2e-15};
constexpr AccuracyGoal kInverse = {1e-14, 1e-14};
constexpr AccuracyGoal kExact = {0.0, 0.0};
constexpr AccuracyGoal kNonCentral = {1e-10, 1e-10};

using BinomialFunction = double (*)(double x, double n, double prob, long& err);

double Checked(BinomialFunction function, const double* a) {
  long err = 0;
  const double value = function(a[0], a[1], a[2], err);
  return err == 0 ? value : std::numeric_limits<double>::quiet_NaN();
}

double CheckedHyper(const double* a) {
  long err = 0;
  const double value = MCDistFun::CDFHyper(a[0], a[1], a[2], a[3], err);
  return err == 0 ? value : std::numeric_limits<double>::quiet_NaN();
}

/// The sample of make_samples.py that a seed, a count and a kind of weights stand for.
class Sample {
 public:
  explicit Sample(const double* a) : state_(static_cast<std::uint32_t>(a[0])) {
    const auto seed = state_;
    const int kind = static_cast<int>(a[2]);
    for (int i = 0; i < static_cast<int>(a[1]); ++i) {
      const std::uint32_t value = Draw(seed % 3 == 0 ? 6 : 1000);
      values_.push_back((value + 8) / 8.0);
      if (kind > 0) weights_.push_back(kind == 1 ? Draw(4) : (Draw(8) + 1) / 4.0);
      if (Draw(5) == 0 && seed % 4 == 0) values_.back() = MCCommon_800::MCMV::gMissingValue;
    }
  }

  double Percentile(double p, double method) {
    return MCDistFun::GPTile(static_cast<long>(values_.size()), values_.data(),
                             weights_.empty() ? nullptr : weights_.data(), p,
                             static_cast<MCDistFun::PercentileMethod>(method));
  }

 private:
  std::uint32_t Draw(std::uint32_t count) {
    state_ = (state_ * 1103515245u + 12345u) % 2147483648u;
    return (state_ >> 8) % count;
  }

  std::uint32_t state_;
  std::vector<double> values_;
  std::vector<double> weights_;
};

struct MedianInterval {
  double coverage;
  double lower;
  double upper;

  /// Of the whole numbers from 1 to n, largest first: the bounds are ranks.
  explicit MedianInterval(const double* a) {
    std::vector<double> values;
    for (double value = a[0]; value >= 1.0; value -= 1.0)
      values.push_back(value);
    coverage = MCDistFun::Mednci(static_cast<long>(values.size()), values.data(), a[1], lower, upper);
  }
};

// Halving and doubling are exact, so the tables of the gamma distribution serve for chi-square as well.
const std::vector<ReferenceFunction> kFunctions = {
    // name                table     arguments    result      call
    {"CdfStdNorm(x)", "normal", "x", "cdf", [](const double* a) { return MCDistFun::CdfStdNorm(a[0]); },
     kCentral},
    {"IdfStdNorm(p)",
     "normal",
     "cdf",
     "quantile",
     [](const double* a) { return MCDistFun::IdfStdNorm(a[0]); },
     kInverse,
     {0, [](const double*, double x) { return MCDistFun::CdfStdNorm(x); }}},
    {"CdfT(x, df)", "t", "x df", "cdf", [](const double* a) { return MCDistFun::CdfT(a[0], a[1]); },
     kCentral},
    {"SigT(x, df)", "t", "x df", "sig", [](const double* a) { return MCDistFun::SigT(a[0], a[1]); },
     kCentral},
    {"IdfT(p, df)",
     "t",
     "cdf df",
     "quantile",
     [](const double* a) { return MCDistFun::IdfT(a[0], a[1]); },
     kInverse,
     {0, [](const double* a, double x) { return MCDistFun::CdfT(x, a[1]); }}},
    {"CdfGam(x, shape, 1)", "gamma", "x shape", "cdf",
     [](const double* a) { return MCDistFun::CdfGam(a[0], a[1], 1.0); }, kCentral},
    {"IdfGam(p, shape, 1)",
     "gamma",
     "cdf shape",
     "quantile",
     [](const double* a) { return MCDistFun::IdfGam(a[0], a[1], 1.0); },
     kInverse,
     {0, [](const double* a, double x) { return MCDistFun::CdfGam(x, a[1], 1.0); }}},
    {"CdfChi(2x, 2 shape)", "gamma", "x shape", "cdf",
     [](const double* a) { return MCDistFun::CdfChi(2.0 * a[0], 2.0 * a[1]); }, kCentral},
    {"SigChi(2x, 2 shape)", "gamma", "x shape", "sig",
     [](const double* a) { return MCDistFun::SigChi(2.0 * a[0], 2.0 * a[1]); }, kCentral},
    {"IdfChi(p, 2 shape)",
     "gamma",
     "cdf shape",
     "quantile",
     [](const double* a) { return MCDistFun::IdfChi(a[0], 2.0 * a[1]) / 2.0; },
     kInverse,
     {0, [](const double* a, double x) { return MCDistFun::CdfChi(2.0 * x, 2.0 * a[1]); }}},
    {"CdfF(x, df1, df2)", "f", "x df1 df2", "cdf",
     [](const double* a) { return MCDistFun::CdfF(a[0], a[1], a[2]); }, kCentral},
    {"SigF(x, df1, df2)", "f", "x df1 df2", "sig",
     [](const double* a) { return MCDistFun::SigF(a[0], a[1], a[2]); }, kCentral},
    {"IdfF(p, df1, df2)",
     "f",
     "cdf df1 df2",
     "quantile",
     [](const double* a) { return MCDistFun::IdfF(a[0], a[1], a[2]); },
     kInverse,
     {0, [](const double* a, double x) { return MCDistFun::CdfF(x, a[1], a[2]); }}},
    {"CdfBeta(x, a, b)", "beta", "x a b", "cdf",
     [](const double* a) { return MCDistFun::CdfBeta(a[0], a[1], a[2]); }, kCentral},
    {"IdfBeta(p, a, b)",
     "beta",
     "cdf a b",
     "quantile",
     [](const double* a) { return MCDistFun::IdfBeta(a[0], a[1], a[2]); },
     kInverse,
     {0, [](const double* a, double x) { return MCDistFun::CdfBeta(x, a[1], a[2]); }}},
    {"vexadnlgam(x)", "lgamma", "x", "value", [](const double* a) { return MCDistFun::vexadnlgam(a[0]); },
     kCentral},
    {"PdfBin(x, n, prob)", "binomial", "k n p", "pdf",
     [](const double* a) { return Checked(MCDistFun::PdfBin, a); }, kCentral},
    {"CdfBin(x, n, prob)", "binomial", "k n p", "cdf",
     [](const double* a) { return Checked(MCDistFun::CdfBin, a); }, kCentral},
    {"IdfBin(p, n, prob)", "binomial", "middle n p", "k",
     [](const double* a) { return Checked(MCDistFun::IdfBin, a); }, kExact},
    {"CDFHyper(x, total, successes, draws)", "hypergeometric", "k total successes draws", "cdf", CheckedHyper,
     kCentral},
    {"NonCentralCdfT(x, df, nc)", "noncentral_t", "x df nc", "cdf",
     [](const double* a) { return MCDistFun::NonCentralCdfT(a[0], a[1], a[2]); }, kNonCentral},
    {"NonCentralCdfChi(x, df, nc)", "noncentral_chi", "x df nc", "cdf",
     [](const double* a) { return MCDistFun::NonCentralCdfChi(a[0], a[1], a[2]); }, kNonCentral},
    {"NonCentralCdfF(x, df1, df2, nc)", "noncentral_f", "x df1 df2 nc", "cdf",
     [](const double* a) { return MCDistFun::NonCentralCdfF(a[0], a[1], a[2], a[3]); }, kNonCentral},
    {"FindNCParamT(x, df, p)",
     "noncentral_t",
     "x df cdf",
     "nc_root",
     [](const double* a) { return MCDistFun::FindNCParamT(a[0], a[1], a[2]); },
     kNonCentral,
     {2, [](const double* a, double nc) { return MCDistFun::NonCentralCdfT(a[0], a[1], nc); }}},
    {"FindNCParamChi(x, df, p)",
     "noncentral_chi",
     "x df cdf",
     "nc_root",
     [](const double* a) { return MCDistFun::FindNCParamChi(a[0], a[1], a[2]); },
     kNonCentral,
     {2, [](const double* a, double nc) { return MCDistFun::NonCentralCdfChi(a[0], a[1], nc); }}},
    {"FindNCParamF(x, df1, df2, p)",
     "noncentral_f",
     "x df1 df2 cdf",
     "nc_root",
     [](const double* a) { return MCDistFun::FindNCParamF(a[0], a[1], a[2], a[3]); },
     kNonCentral,
     {3, [](const double* a, double nc) { return MCDistFun::NonCentralCdfF(a[0], a[1], a[2], nc); }}},
    {"GPTile(sample, p, method)", "percentile", "seed n kind p method", "value",
     [](const double* a) { return Sample(a).Percentile(a[3], a[4]); }, kCentral},
    {"Mednci(n, level)", "median_interval", "n level", "coverage",
     [](const double* a) { return MedianInterval(a).coverage; }, kCentral},
    {"Mednci(n, level) lower", "median_interval", "n level", "lower",
     [](const double* a) { return MedianInterval(a).lower; }, kExact},
    {"Mednci(n, level) upper", "median_interval", "n level", "upper",
     [](const double* a) { return MedianInterval(a).upper; }, kExact},
};

size_t ColumnOf(const PlainTable& table, const std::string& name) {
  const auto found = std::find(table.header.begin(), table.header.end(), name);
  if (found == table.header.end()) throw std::runtime_error("no column " + name);
  return static_cast<size_t>(found - table.header.begin());
}

}  // namespace

const std::vector<ReferenceFunction>& ReferenceFunctions() {
  return kFunctions;
}

std::vector<ReferencePoint> ReadReferencePoints(const ReferenceFunction& function, size_t step) {
  const PlainTable table =
      ReadPlainTable(std::string(KESTREL_SOURCE_DIR "/tests/data/math/") + function.table + ".csv");
  std::vector<size_t> columns;
  std::istringstream names(function.arguments);
  for (std::string name; names >> name;)
    columns.push_back(ColumnOf(table, name));
  const size_t result = ColumnOf(table, function.result);
  std::vector<ReferencePoint> points;
  for (size_t row = 0; row < table.rows.size(); row += step) {
    const std::vector<std::string>& cells = table.rows[row];
    if (cells[result].empty() || cells[columns[0]].empty()) continue;
    ReferencePoint point{};
    for (size_t i = 0; i < columns.size(); ++i)
      point.arguments[i] = std::strtod(cells[columns[i]].c_str(), nullptr);
    point.value = std::strtold(cells[result].c_str(), nullptr);
    points.push_back(point);
  }
  return points;
}

double RelativeError(double value, const ReferencePoint& point) {
  const long double difference = std::fabs(static_cast<long double>(value) - point.value);
  const long double error = difference == 0.0L ? 0.0L : difference / std::fabs(point.value);
  return std::isnan(error) ? std::numeric_limits<double>::infinity() : static_cast<double>(error);
}

double Condition(const ReferenceFunction& function, const ReferencePoint& point) {
  if (function.back.call == nullptr) return 0.0;
  // So small that the probability is a straight line, so large that its rounding does not show.
  constexpr double kStep = 0x1p-30;
  const auto back = [&](double factor) {
    return function.back.call(point.arguments, static_cast<double>(point.value) * factor);
  };
  return 2.0 * kStep * point.arguments[function.back.place] /
         std::fabs(back(1.0 + kStep) - back(1.0 - kStep));
}

RoundTrip TurnBack(const ReferenceFunction& function, const double* arguments) {
  const double p = arguments[function.back.place];
  const double result = function.call(arguments);
  const auto back = [&](double x) { return function.back.call(arguments, x); };
  constexpr double kInfinity = std::numeric_limits<double>::infinity();
  const double width = back(std::nextafter(result, kInfinity)) - back(std::nextafter(result, -kInfinity));
  // The neighbours are two units apart.
  return {std::fabs(back(result) - p) / p, std::fabs(width) / 4.0 / p};
}

}  // namespace kestrel_tests
