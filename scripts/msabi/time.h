// Wine's time.h, plus what libc++ needs of Visual Studio's and Wine's lacks.
#pragma once
#include_next <time.h>

struct timespec {
    time_t tv_sec;
    long tv_nsec;
};
