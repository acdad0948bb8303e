// Wine's ctype.h, plus what libc++ needs of Visual Studio's and Wine's lacks.
#pragma once
#include_next <ctype.h>

int __cdecl _islower_l(int, _locale_t);
int __cdecl _isupper_l(int, _locale_t);
