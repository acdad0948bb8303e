// Wine's math.h, plus what Visual Studio's declares and Wine's lacks (the check compiles only,
// so declarations are enough). Found between libc++'s math.h and Wine's by include order.
#pragma once
#include_next <math.h>

#define KARVEL_MSABI_L1(f) long double __cdecl f##l(long double);
#define KARVEL_MSABI_L2(f) long double __cdecl f##l(long double, long double);
KARVEL_MSABI_L1(acos) KARVEL_MSABI_L1(asin) KARVEL_MSABI_L1(atan) KARVEL_MSABI_L1(ceil)
KARVEL_MSABI_L1(cos) KARVEL_MSABI_L1(cosh) KARVEL_MSABI_L1(exp) KARVEL_MSABI_L1(fabs)
KARVEL_MSABI_L1(floor) KARVEL_MSABI_L1(log) KARVEL_MSABI_L1(log10) KARVEL_MSABI_L1(sin)
KARVEL_MSABI_L1(sinh) KARVEL_MSABI_L1(sqrt) KARVEL_MSABI_L1(tan) KARVEL_MSABI_L1(tanh)
KARVEL_MSABI_L1(acosh) KARVEL_MSABI_L1(asinh) KARVEL_MSABI_L1(atanh) KARVEL_MSABI_L1(cbrt)
KARVEL_MSABI_L1(erf) KARVEL_MSABI_L1(erfc) KARVEL_MSABI_L1(exp2) KARVEL_MSABI_L1(expm1)
KARVEL_MSABI_L1(lgamma) KARVEL_MSABI_L1(log1p) KARVEL_MSABI_L1(log2) KARVEL_MSABI_L1(logb)
KARVEL_MSABI_L1(nearbyint) KARVEL_MSABI_L1(tgamma) KARVEL_MSABI_L2(atan2) KARVEL_MSABI_L2(fmod)
KARVEL_MSABI_L2(pow) KARVEL_MSABI_L2(fdim) KARVEL_MSABI_L2(fmax) KARVEL_MSABI_L2(fmin)
KARVEL_MSABI_L2(hypot) KARVEL_MSABI_L2(nextafter) KARVEL_MSABI_L2(remainder)
#undef KARVEL_MSABI_L1
#undef KARVEL_MSABI_L2
long double __cdecl frexpl(long double, int*);
long double __cdecl ldexpl(long double, int);
long double __cdecl modfl(long double, long double*);
int __cdecl ilogbl(long double);
long double __cdecl remquol(long double, long double, int*);
long double __cdecl scalblnl(long double, long);
long double __cdecl scalbnl(long double, int);
double __cdecl erfc(double);
float __cdecl erfcf(float);
double __cdecl nexttoward(double, long double);
float __cdecl nexttowardf(float, long double);
long double __cdecl nexttowardl(long double, long double);
double __cdecl nan(const char*);
float __cdecl nanf(const char*);
long double __cdecl nanl(const char*);
double __cdecl fma(double, double, double);
float __cdecl fmaf(float, float, float);
long double __cdecl fmal(long double, long double, long double);
