#pragma once
// Compile-time checks of binary layouts: field offsets and sizes. Each table states an offset
// once where the four ABIs that hosts use agree (GCC/MinGW and Microsoft, 32- and 64-bit), and
// per ABI where they cannot. The Microsoft values are what Visual Studio hosts compile against;
// scripts/check-msabi.sh evaluates these asserts under that ABI.
#include <cstddef>

#if defined(__GNUC__)
// NOTE: offsetof on a class with a virtual table is conditionally supported; GCC, Clang and MSVC
// all give the real offset.
#  pragma GCC diagnostic ignored "-Winvalid-offsetof"
#endif

#define KARVEL_FIELD(T, f, off) static_assert(offsetof(T, f) == (off), #T "::" #f " moved")
#define KARVEL_SIZE(T, n) static_assert(sizeof(T) == (n), "size of " #T " changed")

// The value for 32-bit Windows targets, or for 64-bit ones (and every non-Windows target).
#if defined(_WIN32) && !defined(_WIN64)
#  define KARVEL_PICK(bits32, bits64) (bits32)
#else
#  define KARVEL_PICK(bits32, bits64) (bits64)
#endif

// The value per ABI, where GCC and Microsoft lay a class out differently.
#if defined(_MSC_VER)
#  define KARVEL_PICK_ABI(gnu32, gnu64, ms32, ms64) KARVEL_PICK(ms32, ms64)
#else
#  define KARVEL_PICK_ABI(gnu32, gnu64, ms32, ms64) KARVEL_PICK(gnu32, gnu64)
#endif
