#pragma once
/// @file
/// The Windows handle types of the interface (HDC, HWND, HGLRC, HBITMAP). On Windows this is
/// <windows.h> itself, so a host's own handles pass straight through; elsewhere the handles are
/// opaque pointer types of the same shape, so the interfaces compile and their own behaviour can
/// be tested without Windows.
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
