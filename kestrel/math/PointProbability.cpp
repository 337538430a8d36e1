#include "kestrel/math/PointProbability.h"

#include <algorithm>
#include <cmath>

#include "kestrel/math/MCPower.h"
#include "kestrel/math/SaddlePoint.h"

namespace MCMath_800 {

namespace {

constexpr double kTwoPi = 6.283185307179586;

/// A quotient of factorials by Stirling's formula, m! = m^m e^-m sqrt(2 pi m) e^StirlingError(m), without the
/// powers, which the deviances hold. 0! is 1, and 0^0 e^-0 as well.
class FactorialQuotient {
 public:
  void Multiply(double m) {
    above_ *= TwoPiTimes(m);
    error_ += StirlingErrorOfCount(m);
  }
  void Divide(double m) {
    below_ *= TwoPiTimes(m);
    error_ -= StirlingErrorOfCount(m);
  }
  /// The quotient times e^-(a + b), a and b deviances.
  double Times(DoubleDouble a, DoubleDouble b) const {
    const DoubleDouble sum = AddExactly(a.high, b.high);
    return std::sqrt(above_ / below_) *
           GuardedExpMinus(AddExactly(sum.high, sum.low + (a.low + b.low) - error_));
  }

 private:
  static double TwoPiTimes(double m) { return m == 0.0 ? 1.0 : kTwoPi * m; }

  double above_ = 1.0;
  double below_ = 1.0;
  double error_ = 0.0;
};

/// The nodes above 0 and the weights of Gauss's quadrature with 32 points on [-1, 1].
struct Node {
  double at;
  double weight;
};
constexpr Node kNodes[] = {
    {0.04830766568773831623, 0.09654008851472780057}, {0.1444719615827964935, 0.09563872007927485942},
    {0.2392873622521370745, 0.09384439908080456564},  {0.3318686022821276498, 0.09117387869576388471},
    {0.4213512761306353454, 0.08765209300440381114},  {0.50689990893222939, 0.08331192422694675522},
    {0.587715757240762329, 0.07819389578707030647},   {0.663044266930215201, 0.07234579410884850623},
    {0.7321821187402896804, 0.06582222277636184684},  {0.794483795967942407, 0.05868409347853554715},
    {0.8493676137325699701, 0.0509980592623761762},   {0.896321155766052124, 0.04283589802222668066},
    {0.9349060759377396892, 0.0342738629130214331},   {0.9647622555875064308, 0.02539206530926205946},
    {0.9856115115452683354, 0.01627439473090567061},  {0.9972638618494815635, 0.0070186100094700966},
};

/// The tables with the margins of one table, along the number of drawn successes.
class TableCurve {
 public:
  explicit TableCurve(const FourFold& table)
      : cells_{table.drawnSuccesses, table.leftSuccesses, table.drawnFailures, table.leftFailures} {
    const DoubleDouble rows[] = {AddExactly(cells_[0], cells_[1]), AddExactly(cells_[2], cells_[3])};
    const DoubleDouble columns[] = {AddExactly(cells_[0], cells_[2]), AddExactly(cells_[1], cells_[3])};
    const DoubleDouble total = rows[0] + rows[1];
    for (int cell = 0; cell < 4; ++cell)
      means_[cell] = rows[cell / 2] * columns[cell % 2] / total;
    for (const DoubleDouble& margin : {rows[0], rows[1], columns[0], columns[1]})
      margins_.Multiply(margin.high);
    margins_.Divide(total.high);
    // Of this the cells alone have lost digits.
    deviation_ = (MultiplyExactly(cells_[0], cells_[3]) - MultiplyExactly(cells_[1], cells_[2])) / total;
  }

  /// The probability of the table with `step` drawn successes fewer.
  double Below(double step) const {
    FactorialQuotient factorials = margins_;
    DoubleDouble deviances[4];
    for (int cell = 0; cell < 4; ++cell) {
      const bool shrinks = cell == 0 || cell == 3;
      const DoubleDouble count = AddExactly(cells_[cell], shrinks ? -step : step);
      const DoubleDouble up = deviation_ - step;
      factorials.Divide(count.high);
      const auto mean = [&] { return means_[cell]; };
      deviances[cell] = count.high == 0.0 ? means_[cell] : Deviance(mean, shrinks ? -up : up, count);
    }
    return factorials.Times(deviances[0] + deviances[1], deviances[2] + deviances[3]);
  }

 private:
  double cells_[4];
  DoubleDouble means_[4];
  DoubleDouble deviation_;
  FactorialQuotient margins_;
};

/// Adds up the tail term by term; the quotients of neighbours are rational. Hundreds of terms would show
/// their rounding.
double SumOfTerms(const FourFold& table, double first) {
  double a = table.drawnSuccesses, b = table.leftSuccesses, c = table.drawnFailures, d = table.leftFailures;
  DoubleDouble sum = 1.0, term = 1.0;
  while (a > 0.0 && d > 0.0 && term.high > 1e-17 * sum.high) {
    b += 1.0;
    c += 1.0;
    term = term * (MultiplyExactly(a, d) / MultiplyExactly(b, c));
    sum = sum + term;
    a -= 1.0;
    d -= 1.0;
  }
  return first * sum.high;
}

/// What the derivatives of the curve through the probabilities add to its integral to make the sum
/// (Euler and Maclaurin), as a multiple of the probability at the end.
double EndCorrection(const FourFold& table) {
  double first = 0.0, second = 0.0, third = 0.0;  // derivatives of the curve's logarithm
  const auto add = [&](double cell, double sign) {
    const double middle = cell + 0.5;
    first -= sign / (24.0 * middle * middle);
    second -= 1.0 / middle;
    third += sign / (middle * middle);
  };
  add(table.drawnSuccesses, 1.0);
  add(table.leftSuccesses, -1.0);
  add(table.drawnFailures, -1.0);
  add(table.leftFailures, 1.0);
  first += std::log((table.leftSuccesses + 0.5) / (table.drawnSuccesses + 0.5) *
                    ((table.drawnFailures + 0.5) / (table.leftFailures + 0.5)));
  const double square = first * first;
  const double thirdOfCurve = first * (square + 3.0 * second) + third;
  const double fifthOfCurve =
      first * (square * (square + 10.0 * second) + 15.0 * second * second) + 10.0 * third * (square + second);
  const double seventhOfCurve =
      first * (square * (square * (square + 21.0 * second) + 105.0 * second * second) +
               105.0 * second * second * second) +
      35.0 * third * square * (square + 6.0 * second);
  return 0.5 + first / 12.0 - thirdOfCurve / 720.0 + fifthOfCurve / 30240.0 - seventhOfCurve / 1209600.0;
}

}  // namespace

double BinomialProbability(double k, double n, double prob) {
  FactorialQuotient factorials;
  factorials.Multiply(n);
  factorials.Divide(k);
  factorials.Divide(n - k);
  const DoubleDouble mean = MultiplyExactly(n, prob);
  const DoubleDouble above = AddExactly(mean.high, -k);
  const DoubleDouble distance = {above.high, above.low + mean.low};
  const double left = n - k;
  const DoubleDouble successes = k == 0.0 ? mean : Deviance([&] { return mean; }, distance, k);
  const auto failure_mean = [&] { return AddExactly(1.0, -prob) * n; };
  return factorials.Times(successes, left == 0.0 ? failure_mean() : Deviance(failure_mean, -distance, left));
}

double HypergeometricProbability(const FourFold& table) {
  return TableCurve(table).Below(0.0);
}

double HypergeometricLowerTail(const FourFold& table) {
  const TableCurve curve(table);
  const double last = curve.Below(0.0);
  // How far down the terms matter: the logarithm falls by 40 with the slope and the curvature at the end.
  const double b = table.leftSuccesses + 1.0, c = table.drawnFailures + 1.0;
  const double a = table.drawnSuccesses + 1.0, d = table.leftFailures + 1.0;
  const double slope = std::max(0.0, std::log(b / a * (c / d)));
  const double curvature = 1.0 / a + 1.0 / b + 1.0 / c + 1.0 / d;
  const double length = 80.0 / (slope + std::sqrt(slope * slope + 80.0 * curvature));
  constexpr double kManyTerms = 300.0;
  // Where a cell runs empty within that length there are too few terms to need anything else.
  if (length < kManyTerms || std::min(a, d) < 1.05 * length + 100.0) return SumOfTerms(table, last);
  const double half = 0.525 * length;
  double integral = 0.0;
  for (const Node& node : kNodes) {
    const double step = half * node.at;
    integral += node.weight * (curve.Below(half - step) + curve.Below(half + step));
  }
  return half * integral + last * EndCorrection(table);
}

}  // namespace MCMath_800
