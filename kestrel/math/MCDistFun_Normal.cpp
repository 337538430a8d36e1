// The normal distribution and the error function.

#include <cmath>

#include "kestrel/foundation/MCMV.h"
#include "kestrel/math/ErfcTable.h"
#include "kestrel/math/ErrorFunction.h"
#include "kestrel/math/MCDistFun.h"
#include "kestrel/math/Polynomial.h"
#include "kestrel/math/SaddlePoint.h"

namespace MCMath_800 {

using MCCommon_800::MCMV;

namespace {

// The error function after T. Ooura's table-driven approximations for double precision, lowest power first.
// Held against 40 digits, the polynomials are within 4e-17 (relative) of the functions that they stand for.

// erf(a) / a in a^2 - k, for k <= a^2 < k + 1.
constexpr double kErf[5][13] = {
    {1.12837916709551257377, -0.37612638903183748117, 0.11283791670954881569, -0.0268661706450773342,
     0.00522397762482322257, -8.548326981129666e-4, 1.2055331122299265e-4, -1.492559551950604e-5,
     1.6461004480962e-6, -1.635035446196e-7, 1.466005199839e-8, -1.13739022964e-9, 5.958930743e-11},
    {0.84270079294971486929, -0.2137966477645600658, 0.05657061146827041994, -0.0125498847718219221,
     0.00233307631218880978, -3.7015410692956173e-4, 5.10388300970969e-5, -6.21188515924e-6,
     6.7595634268133e-7, -6.642090827576e-8, 5.90362766598e-9, -4.5493253732e-10, 2.372510631e-11},
    {0.67493323603965504676, -0.13055593046562267625, 0.02986978465246258244, -0.00608284718113590151,
     0.00107052153564110318, -1.6358986921372656e-4, 2.195455056768781e-5, -2.61830022482897e-6,
     2.8045522331686e-7, -2.721444369609e-8, 2.39463074e-9, -1.8310229805e-10, 9.49905026e-12},
    {0.56909076642393639985, -0.08548534594781312114, 0.01668977892553165586, -0.00307553051439272889,
     5.0689993654144881e-4, -7.404402135070773e-5, 9.62023443095201e-6, -1.1199275838265e-6,
     1.1775134830784e-7, -1.126008898854e-8, 9.793057408e-10, -7.421598602e-11, 3.82722073e-12},
    {0.49766113250947636708, -0.05962426839442303805, 0.00988786373932350462, -0.00162940941748079288,
     2.4879276133931664e-4, -3.445026145385764e-5, 4.30683284629395e-6, -4.8722516178974e-7,
     5.011915876293e-8, -4.71135111493e-9, 4.0424830707e-10, -3.032205868e-11, 1.55296588e-12},
};

// erfc(a)^(1/16) in a - k, for k <= a < k + 1, k = 2 to 6.
constexpr double kErfcRoot[5][13] = {
    {0.71511720328842845913, -0.19746892495383021487, -0.01402283663896319337, 0.00815533022524927908,
     1.5380842432375365e-4, -2.5616361025506629e-4, 1.612722157047886e-5, 2.66246030457984e-6,
     -2.1854388148686e-7, -1.6678201321e-8, -6.40788827665e-9, 2.69776334046e-9, -2.9734388465e-10},
    {0.51169696718727644908, -0.2016007277849101314, 0.00909530922354827295, 0.00661062970502241174,
     -8.0991728956032271e-4, -1.1843240273775776e-4, 2.687044575042908e-5, 1.9999935792654e-7,
     -3.5772874310272e-7, 3.42940918551e-9, 5.22461866919e-9, -3.2302692214e-10, -1.951073787e-11},
    {0.32490054966649436974, -0.16725021123116877197, 0.02328095035422810727, 0.00271187003520095655,
     -0.00101565063152200272, 2.854147231653228e-5, 1.947204525295057e-5, -2.03340624738438e-6,
     -1.5451139637086e-7, 3.377623323271e-8, 6.3675740242e-10, -4.8465972408e-10, 3.147682272e-11},
    {0.18267336775296612024, -0.11637092784486193258, 0.02585434424202960464, -7.5285814895230877e-4,
     -6.5860243990455368e-4, 9.823686253424796e-5, 3.68797328322935e-6, -2.11211337219663e-6,
     1.1371857327578e-7, 2.050708040581e-8, -2.64888267434e-9, -6.303206648e-11, 2.31936337e-11},
    {0.09084526782065478489, -0.06905562880005864105, 0.0206412902387602297, -0.0023972961143507161,
     -1.7604388937031815e-4, 8.428418334440096e-5, -6.75407647949153e-6, -7.8441223763969e-7,
     1.8006992266137e-7, -4.35953392472e-9, -1.93319027226e-9, 2.0876046746e-10, -3.67789363e-12},
};

// exp(a^2) erfc(a) / t in t - 1/2, t = kErfcScale / (a + kErfcScale).
constexpr double kScaledErfc[] = {
    0.275374741597376782,   0.490165080585318424,   0.774368199119538609,   1.07925515155856677,
    1.31314653831023098,    1.37040217682338167,    1.18902982909273333,    0.805276408752910567,
    0.357524274449531043,   0.0166207924969367356,  -0.119463959964325415,  -0.0838864557023001992,
    0.00249367200053503304, 0.0390976845588484035,  0.0161315329733252248,  -0.0133823644533460069,
    -0.0127223813782122755, 0.00383335126264887303, 0.00773672528313526668, -8.70779635317295828e-4,
    -0.003963850973605135,  1.19314022838340944e-4, 0.00127109764952614092,
};
constexpr double kErfcScale = 3.97886080735226;

// e^-708: smaller complements count as 0.
constexpr double kSmallestErfc = 3.307553003638408e-308;

// AS 241: M. J. Wichura, "The percentage points of the normal distribution", Applied Statistics 37 (1988)
// 477-484, PPND16. Named as there; in p - 1/2 (A/B), and in sqrt(-ln p) up to 5 (C/D) and beyond (E/F).
constexpr double kA[] = {3.3871328727963666080e0,  1.3314166789178437745e+2, 1.9715909503065514427e+3,
                         1.3731693765509461125e+4, 4.5921953931549871457e+4, 6.7265770927008700853e+4,
                         3.3430575583588128105e+4, 2.5090809287301226727e+3};
constexpr double kB[] = {1.0,
                         4.2313330701600911252e+1,
                         6.8718700749205790830e+2,
                         5.3941960214247511077e+3,
                         2.1213794301586595867e+4,
                         3.9307895800092710610e+4,
                         2.8729085735721942674e+4,
                         5.2264952788528545610e+3};
constexpr double kC[] = {1.42343711074968357734e0,  4.63033784615654529590e0, 5.76949722146069140550e0,
                         3.64784832476320460504e0,  1.27045825245236838258e0, 2.41780725177450611770e-1,
                         2.27238449892691845833e-2, 7.74545014278341407640e-4};
constexpr double kD[] = {1.0,
                         2.05319162663775882187e0,
                         1.67638483018380384940e0,
                         6.89767334985100004550e-1,
                         1.48103976427480074590e-1,
                         1.51986665636164571966e-2,
                         5.47593808499534494600e-4,
                         1.05075007164441684324e-9};
constexpr double kE[] = {6.65790464350110377720e0,  5.46378491116411436990e0,  1.78482653991729133580e0,
                         2.96560571828504891230e-1, 2.65321895265761230930e-2, 1.24266094738807843860e-3,
                         2.71155556874348757815e-5, 2.01033439929228813265e-7};
constexpr double kF[] = {1.0,
                         5.99832206555887937690e-1,
                         1.36929880922735805310e-1,
                         1.48753612908506148525e-2,
                         7.86869131145613259100e-4,
                         1.84631831751005468180e-5,
                         1.42151175831644588870e-7,
                         2.04426310338993978564e-15};

constexpr double kSqrt2 = 1.41421356237309504880;
constexpr double kSqrtPi = 1.77245385090551602730;

// y exp(-base^2 * factor), where y is the scaled complement and factor 1 or 1/2. A square of 700 is off by
// 1e-13 when it is rounded, and so would be the exponential.
double TailExponential(double y, double base, double factor) {
  const double tail = y * GuardedExpMinus(MultiplyExactly(base, base) * factor);
  return tail < kSmallestErfc ? 0.0 : tail;
}

// In one piece, as published; ScaledErfc has more digits.
double PublishedScaledErfc(double a) {
  const double t = kErfcScale / (a + kErfcScale);
  return Polynomial(kScaledErfc, t - 0.5) * t;
}

}  // namespace

double ScaledErfc(double a) {
  if (a < kErfcEnd) {
    const int part = static_cast<int>(a * kErfcPartsPerUnit);
    return Polynomial(kErfcParts[part], a - (part + 0.5) / kErfcPartsPerUnit);
  }
  return Polynomial(kErfcFar, 1.0 / (a * a)) / (kSqrtPi * a);
}

double MCDistFun::derf(const double& x) {
  const double a = std::fabs(x);
  if (a >= 6.9) return x < 0.0 ? -1.0 : 1.0;
  double value;
  if (a < 2.2) {
    const double t = a * a;
    const int k = static_cast<int>(t);
    value = a * Polynomial(kErf[k], t - k);
  } else {
    const int k = static_cast<int>(a);
    double y = Polynomial(kErfcRoot[k - 2], a - k);
    y *= y;
    y *= y;
    y *= y;
    value = 1.0 - y * y;
  }
  return x < 0.0 ? -value : value;
}

// As published the complement is exp(ln y - a^2), and 0 when that exponent is below -708. The split
// exponential is the same number with more of its digits right in the tail, and needs no logarithm.
double MCDistFun::derfc(const double& x) {
  if (x == 0.0) return 1.0;
  const double a = std::fabs(x);
  const double tail = TailExponential(PublishedScaledErfc(a), a, 1.0);
  return x < 0.0 ? 2.0 - tail : tail;
}

// The lower tail is derfc(-z / sqrt 2) / 2, with z^2 / 2 taken of z itself: the quotient is rounded, and its
// square would carry that into the exponent.
double MCDistFun::prbnrm(const double& z) {
  if (z > 0.0) return (derf(z / kSqrt2) + 1.0) / 2.0;
  if (z == 0.0) return 0.5;
  return TailExponential(PublishedScaledErfc(-z / kSqrt2), -z, 0.5) / 2.0;
}

double MCDistFun::probit(const double& p) {
  if (!(p > 0.0 && p < 1.0)) return MCMV::gMissingValue;
  const double q = p - 0.5;
  if (std::fabs(q) <= 0.425) {
    const double r = 0.180625 - q * q;
    return q * Polynomial(kA, r) / Polynomial(kB, r);
  }
  const double r = std::sqrt(-std::log(q < 0.0 ? p : 1.0 - p));
  const double value = r <= 5.0 ? Polynomial(kC, r - 1.6) / Polynomial(kD, r - 1.6)
                                : Polynomial(kE, r - 5.0) / Polynomial(kF, r - 5.0);
  return q < 0.0 ? -value : value;
}

double MCDistFun::CdfStdNorm(double x) {
  return std::isnan(x) ? MCMV::gMissingValue : prbnrm(x);
}

double MCDistFun::CdfNorm(double x, double mean, double sd) {
  if (std::isnan(x) || !std::isfinite(mean) || !(sd > 0.0) || !std::isfinite(sd)) return MCMV::gMissingValue;
  const double z = (x - mean) / sd;
  return prbnrm(z);
}

double MCDistFun::IdfStdNorm(double p) {
  return probit(p);
}

double MCDistFun::IdfNorm(double p, double mean, double sd) {
  if (!(p > 0.0 && p < 1.0) || !std::isfinite(mean) || !(sd > 0.0) || !std::isfinite(sd)) {
    return MCMV::gMissingValue;
  }
  if (p == 0.5) return mean;
  const double x = probit(p) * sd + mean;
  return std::isfinite(x) ? x : MCMV::gMissingValue;
}

}  // namespace MCMath_800
