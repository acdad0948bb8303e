#pragma once
// Compile-time checks of binary layouts: field offsets and sizes per target width.
#include <cstddef>

#if defined(__GNUC__)
// NOTE: offsetof on a class with a virtual table is conditionally supported; GCC, Clang and MSVC
// all give the real offset.
#  pragma GCC diagnostic ignored "-Winvalid-offsetof"
#endif

#define KARVEL_FIELD(T, f, off) static_assert(offsetof(T, f) == (off), #T "::" #f " moved")
#define KARVEL_SIZE(T, n) static_assert(sizeof(T) == (n), "size of " #T " changed")

// The value for 32-bit Windows targets, or for 64-bit ones.
#if defined(_WIN32) && !defined(_WIN64)
#  define KARVEL_PICK(bits32, bits64) (bits32)
#else
#  define KARVEL_PICK(bits32, bits64) (bits64)
#endif
