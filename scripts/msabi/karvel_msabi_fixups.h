// Force-included into every file that the Microsoft-ABI check compiles. Wine's C runtime and
// Windows headers stand in for Visual Studio's there: they lack a few things that libc++ and we
// use (the wrappers beside this file add them) and define some of clang's builtin intrinsics as
// inline functions, which clang refuses. Renaming Wine's definitions avoids the clash; the check
// compiles only, so nothing calls them. Nothing here is part of the library.
#pragma once
#define _InterlockedCompareExchange128 karvel_wine_InterlockedCompareExchange128
#if defined(_M_IX86)
#  define _InterlockedAnd64 karvel_wine_InterlockedAnd64
#  define _InterlockedCompareExchangePointer karvel_wine_InterlockedCompareExchangePointer
#  define _InterlockedExchangeAdd64 karvel_wine_InterlockedExchangeAdd64
#  define _InterlockedExchangePointer karvel_wine_InterlockedExchangePointer
#  define _InterlockedIncrement64 karvel_wine_InterlockedIncrement64
#  define _InterlockedDecrement64 karvel_wine_InterlockedDecrement64
#  define _InterlockedOr64 karvel_wine_InterlockedOr64
#  define _InterlockedXor64 karvel_wine_InterlockedXor64
#endif

// GetGuiResources' selectors, missing from Wine's winuser.h.
#define GR_GDIOBJECTS 0
#define GR_USEROBJECTS 1
