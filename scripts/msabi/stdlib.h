// Wine's stdlib.h, plus what libc++ needs of Visual Studio's and Wine's lacks.
#pragma once
#include_next <stdlib.h>

#ifndef MB_CUR_MAX
#  define MB_CUR_MAX ___mb_cur_max_func()
#endif
float __cdecl _strtof_l(const char*, char**, _locale_t);
double __cdecl _strtod_l(const char*, char**, _locale_t);
