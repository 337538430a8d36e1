#include "bench/accuracy/BoostFunctions.h"

#include <boost/math/distributions/beta.hpp>
#include <boost/math/distributions/binomial.hpp>
#include <boost/math/distributions/chi_squared.hpp>
#include <boost/math/distributions/fisher_f.hpp>
#include <boost/math/distributions/gamma.hpp>
#include <boost/math/distributions/hypergeometric.hpp>
#include <boost/math/distributions/non_central_chi_squared.hpp>
#include <boost/math/distributions/non_central_f.hpp>
#include <boost/math/distributions/non_central_t.hpp>
#include <boost/math/distributions/normal.hpp>
#include <boost/math/distributions/students_t.hpp>
#include <boost/math/special_functions/gamma.hpp>
#include <cstring>
#include <exception>
#include <limits>

namespace kestrel_bench {
namespace {

namespace bm = boost::math;
namespace bp = boost::math::policies;

// Failures come back as infinities and NaNs instead of exceptions, as Kestrel's do as the missing value.
using NoThrow = bp::policy<bp::domain_error<bp::ignore_error>, bp::pole_error<bp::ignore_error>,
                           bp::overflow_error<bp::ignore_error>, bp::evaluation_error<bp::ignore_error>,
                           bp::rounding_error<bp::ignore_error>, bp::discrete_quantile<bp::integer_round_up>>;
using Plain = bp::normalise<NoThrow, bp::promote_float<false>, bp::promote_double<false>>::type;

/// Each takes the columns that its namesake takes.
template <class Policy>
struct Functions {
  using Normal = bm::normal_distribution<double, Policy>;
  using T = bm::students_t_distribution<double, Policy>;
  using Gamma = bm::gamma_distribution<double, Policy>;
  using Chi = bm::chi_squared_distribution<double, Policy>;
  using F = bm::fisher_f_distribution<double, Policy>;
  using Beta = bm::beta_distribution<double, Policy>;
  using Binomial = bm::binomial_distribution<double, Policy>;
  using Hyper = bm::hypergeometric_distribution<double, Policy>;
  using ChiNc = bm::non_central_chi_squared_distribution<double, Policy>;
  using FNc = bm::non_central_f_distribution<double, Policy>;
  using TNc = bm::non_central_t_distribution<double, Policy>;

  static double CdfStdNorm(const double* a) { return cdf(Normal(), a[0]); }
  static double IdfStdNorm(const double* a) { return quantile(Normal(), a[0]); }
  static double CdfT(const double* a) { return cdf(T(a[1]), a[0]); }
  static double SigT(const double* a) { return cdf(complement(T(a[1]), a[0])); }
  static double IdfT(const double* a) { return quantile(T(a[1]), a[0]); }
  static double CdfGam(const double* a) { return cdf(Gamma(a[1]), a[0]); }
  static double IdfGam(const double* a) { return quantile(Gamma(a[1]), a[0]); }
  static double CdfChi(const double* a) { return cdf(Chi(2.0 * a[1]), 2.0 * a[0]); }
  static double SigChi(const double* a) { return cdf(complement(Chi(2.0 * a[1]), 2.0 * a[0])); }
  static double IdfChi(const double* a) { return quantile(Chi(2.0 * a[1]), a[0]) / 2.0; }
  static double CdfF(const double* a) { return cdf(F(a[1], a[2]), a[0]); }
  static double SigF(const double* a) { return cdf(complement(F(a[1], a[2]), a[0])); }
  static double IdfF(const double* a) { return quantile(F(a[1], a[2]), a[0]); }
  static double CdfBeta(const double* a) { return cdf(Beta(a[1], a[2]), a[0]); }
  static double IdfBeta(const double* a) { return quantile(Beta(a[1], a[2]), a[0]); }
  static double LogGamma(const double* a) { return bm::lgamma(a[0], Policy()); }
  static double PdfBin(const double* a) { return pdf(Binomial(a[1], a[2]), a[0]); }
  static double CdfBin(const double* a) { return cdf(Binomial(a[1], a[2]), a[0]); }
  static double IdfBin(const double* a) { return quantile(Binomial(a[1], a[2]), a[0]); }
  static double CDFHyper(const double* a) {
    const auto count = [](double number) { return static_cast<unsigned>(number); };
    return cdf(Hyper(count(a[2]), count(a[3]), count(a[1])), a[0]);
  }
  static double NonCentralCdfChi(const double* a) { return cdf(ChiNc(a[1], a[2]), a[0]); }
  static double NonCentralCdfF(const double* a) { return cdf(FNc(a[1], a[2], a[3]), a[0]); }
  static double NonCentralCdfT(const double* a) { return cdf(TNc(a[1], a[2]), a[0]); }
  static double FindNCParamChi(const double* a) { return ChiNc::find_non_centrality(a[1], a[0], a[2]); }
};

// Some root finders throw in spite of the policy.
template <double (*function)(const double*)>
double Guarded(const double* arguments) {
  try {
    return function(arguments);
  } catch (const std::exception&) {
    return std::numeric_limits<double>::quiet_NaN();
  }
}

#define KESTREL_BOTH(name) &Guarded<&Functions<NoThrow>::name>, &Guarded<&Functions<Plain>::name>

constexpr BoostFunction kFunctions[] = {
    {"CdfStdNorm", KESTREL_BOTH(CdfStdNorm)},
    {"IdfStdNorm", KESTREL_BOTH(IdfStdNorm)},
    {"CdfT", KESTREL_BOTH(CdfT)},
    {"SigT", KESTREL_BOTH(SigT)},
    {"IdfT", KESTREL_BOTH(IdfT)},
    {"CdfGam", KESTREL_BOTH(CdfGam)},
    {"IdfGam", KESTREL_BOTH(IdfGam)},
    {"CdfChi", KESTREL_BOTH(CdfChi)},
    {"SigChi", KESTREL_BOTH(SigChi)},
    {"IdfChi", KESTREL_BOTH(IdfChi)},
    {"CdfF", KESTREL_BOTH(CdfF)},
    {"SigF", KESTREL_BOTH(SigF)},
    {"IdfF", KESTREL_BOTH(IdfF)},
    {"CdfBeta", KESTREL_BOTH(CdfBeta)},
    {"IdfBeta", KESTREL_BOTH(IdfBeta)},
    {"vexadnlgam", KESTREL_BOTH(LogGamma)},
    {"PdfBin", KESTREL_BOTH(PdfBin)},
    {"CdfBin", KESTREL_BOTH(CdfBin)},
    {"IdfBin", KESTREL_BOTH(IdfBin)},
    {"CDFHyper", KESTREL_BOTH(CDFHyper)},
    {"NonCentralCdfChi", KESTREL_BOTH(NonCentralCdfChi)},
    {"NonCentralCdfF", KESTREL_BOTH(NonCentralCdfF)},
    {"NonCentralCdfT", KESTREL_BOTH(NonCentralCdfT)},
    {"FindNCParamChi", KESTREL_BOTH(FindNCParamChi)},
};

#undef KESTREL_BOTH

}  // namespace

const BoostFunction* FindBoostFunction(const char* name) {
  const size_t length = std::strcspn(name, "(");
  for (const BoostFunction& function : kFunctions) {
    if (std::strlen(function.name) == length && std::strncmp(function.name, name, length) == 0)
      return &function;
  }
  return nullptr;
}

}  // namespace kestrel_bench
