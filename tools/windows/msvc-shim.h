// What libc++ asks of Microsoft's C library and Wine's headers do not declare. Included by msvc-check before
// everything else; nothing of it is ever linked.

#ifndef TOOLS_WINDOWS_MSVC_SHIM_H
#define TOOLS_WINDOWS_MSVC_SHIM_H

#include <locale.h>
#include <stddef.h>

// As in Microsoft's <stddef.h>: no more than a double's.
typedef double max_align_t;
struct timespec {
  long long tv_sec;
  long tv_nsec;
};
#ifndef MB_CUR_MAX
#define MB_CUR_MAX 2
#endif

#define ONE(name) name##l(long double)
#define TWO(name) name##l(long double, long double)
extern "C" {
long double ONE(acos), ONE(acosh), ONE(asin), ONE(asinh), ONE(atan), ONE(atanh), ONE(cbrt), ONE(ceil),
    ONE(cos), ONE(cosh), ONE(erf), ONE(erfc), ONE(exp), ONE(exp2), ONE(expm1), ONE(fabs), ONE(floor),
    ONE(lgamma), ONE(log), ONE(log10), ONE(log1p), ONE(log2), ONE(logb), ONE(nearbyint), ONE(rint),
    ONE(round), ONE(sin), ONE(sinh), ONE(sqrt), ONE(tan), ONE(tanh), ONE(tgamma), ONE(trunc);
long double TWO(atan2), TWO(copysign), TWO(fdim), TWO(fmax), TWO(fmin), TWO(fmod), TWO(hypot), TWO(nextafter),
    TWO(nexttoward), TWO(pow), TWO(remainder);
long double fmal(long double, long double, long double);
long double frexpl(long double, int*);
int ilogbl(long double);
long double ldexpl(long double, int);
long long llrintl(long double);
long long llroundl(long double);
long lrintl(long double);
long lroundl(long double);
long double modfl(long double, long double*);
long double nanl(const char*);
long double remquol(long double, long double, int*);
long double scalblnl(long double, long);
long double scalbnl(long double, int);
double erfc(double);
float erfcf(float);
double nexttoward(double, long double);
float nexttowardf(float, long double);
int _dupenv_s(char**, size_t*, const char*);
int _islower_l(int, _locale_t);
int _isupper_l(int, _locale_t);
double _strtod_l(const char*, char**, _locale_t);
float _strtof_l(const char*, char**, _locale_t);
int timespec_get(struct timespec*, int);
}
#undef ONE
#undef TWO

#endif  // TOOLS_WINDOWS_MSVC_SHIM_H
