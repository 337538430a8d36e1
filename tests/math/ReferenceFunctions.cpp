#include "tests/math/ReferenceFunctions.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <limits>
#include <sstream>
#include <stdexcept>

#include "kestrel/math/MCDistFun.h"
#include "tests/support/PlainTable.h"

namespace kestrel_tests {
namespace {

using MCMath_800::MCDistFun;

constexpr AccuracyGoal kCentral = {1e-14, 1e-12};
constexpr AccuracyGoal kInverse = {1e-12, 1e-12};

// Halving and doubling are exact, so the tables of the gamma distribution serve for chi-square as well.
const std::vector<ReferenceFunction> kFunctions = {
    // name                table     arguments    result      call
    {"CdfStdNorm(x)", "normal", "x", "cdf", [](const double* a) { return MCDistFun::CdfStdNorm(a[0]); },
     kCentral},
    {"IdfStdNorm(p)", "normal", "cdf", "quantile",
     [](const double* a) { return MCDistFun::IdfStdNorm(a[0]); }, kInverse},
    {"CdfT(x, df)", "t", "x df", "cdf", [](const double* a) { return MCDistFun::CdfT(a[0], a[1]); },
     kCentral},
    {"SigT(x, df)", "t", "x df", "sig", [](const double* a) { return MCDistFun::SigT(a[0], a[1]); },
     kCentral},
    {"IdfT(p, df)", "t", "cdf df", "quantile", [](const double* a) { return MCDistFun::IdfT(a[0], a[1]); },
     kInverse},
    {"CdfGam(x, shape, 1)", "gamma", "x shape", "cdf",
     [](const double* a) { return MCDistFun::CdfGam(a[0], a[1], 1.0); }, kCentral},
    {"IdfGam(p, shape, 1)", "gamma", "cdf shape", "quantile",
     [](const double* a) { return MCDistFun::IdfGam(a[0], a[1], 1.0); }, kInverse},
    {"CdfChi(2x, 2 shape)", "gamma", "x shape", "cdf",
     [](const double* a) { return MCDistFun::CdfChi(2.0 * a[0], 2.0 * a[1]); }, kCentral},
    {"SigChi(2x, 2 shape)", "gamma", "x shape", "sig",
     [](const double* a) { return MCDistFun::SigChi(2.0 * a[0], 2.0 * a[1]); }, kCentral},
    {"IdfChi(p, 2 shape)", "gamma", "cdf shape", "quantile",
     [](const double* a) { return MCDistFun::IdfChi(a[0], 2.0 * a[1]) / 2.0; }, kInverse},
    {"CdfF(x, df1, df2)", "f", "x df1 df2", "cdf",
     [](const double* a) { return MCDistFun::CdfF(a[0], a[1], a[2]); }, kCentral},
    {"SigF(x, df1, df2)", "f", "x df1 df2", "sig",
     [](const double* a) { return MCDistFun::SigF(a[0], a[1], a[2]); }, kCentral},
    {"IdfF(p, df1, df2)", "f", "cdf df1 df2", "quantile",
     [](const double* a) { return MCDistFun::IdfF(a[0], a[1], a[2]); }, kInverse},
    {"CdfBeta(x, a, b)", "beta", "x a b", "cdf",
     [](const double* a) { return MCDistFun::CdfBeta(a[0], a[1], a[2]); }, kCentral},
    {"IdfBeta(p, a, b)", "beta", "cdf a b", "quantile",
     [](const double* a) { return MCDistFun::IdfBeta(a[0], a[1], a[2]); }, kInverse},
    {"vexadnlgam(x)", "lgamma", "x", "value", [](const double* a) { return MCDistFun::vexadnlgam(a[0]); },
     kCentral},
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

}  // namespace kestrel_tests
