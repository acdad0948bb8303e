#pragma once
/// @file
/// The export macro of karvel.dll.
///
/// @def KARVEL_API
/// Marks what karvel.dll exports: dllimport in a host, dllexport while the DLL is built
/// (KARVEL_BUILD), nothing when KARVEL_STATIC is defined (the library's own tests link its
/// sources statically) or off Windows.
#if defined(_WIN32) && !defined(KARVEL_STATIC)
#  if defined(KARVEL_BUILD)
#    define KARVEL_API __declspec(dllexport)
#  else
#    define KARVEL_API __declspec(dllimport)
#  endif
#else
#  define KARVEL_API
#endif

#if defined(_MSC_VER)
// NOTE: exported classes hold CDorArray members; MSVC warns that the template has no DLL
// interface, but it is header-only and instantiated identically on both sides.
#  pragma warning(disable : 4251)
#endif
