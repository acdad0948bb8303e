#pragma once
// The one place where the portable tier meets Windows handle types. On Windows this is
// <windows.h> itself; elsewhere the handles are opaque pointer types of the same shape, so the
// interfaces compile and their own behaviour can be tested without Windows.
#if defined(_WIN32)
#  include <windows.h>
#else
struct HDC__;
typedef HDC__* HDC;
struct HWND__;
typedef HWND__* HWND;
struct HGLRC__;
typedef HGLRC__* HGLRC;
struct HBITMAP__;
typedef HBITMAP__* HBITMAP;
#endif
