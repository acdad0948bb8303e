#pragma once
// KARVEL_API marks the classes that karvel.dll exports. Define KARVEL_STATIC to link the
// library's sources statically (the test programs do); KARVEL_BUILD is set while building the DLL.
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
