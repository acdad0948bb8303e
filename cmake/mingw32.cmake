# Cross build for 32-bit Windows; programs run under 32-bit Wine (scripts/test32.sh).
set(CMAKE_SYSTEM_NAME Windows)
set(CMAKE_SYSTEM_PROCESSOR i686)
set(KARVEL_MINGW_PREFIX i686-w64-mingw32)
# SSE2 maths, as Visual Studio's x86 default (/arch:SSE2): x87 registers keep excess precision,
# which changes results that the tests compare exactly.
set(CMAKE_C_FLAGS_INIT "-msse2 -mfpmath=sse")
set(CMAKE_CXX_FLAGS_INIT "-msse2 -mfpmath=sse")
include(${CMAKE_CURRENT_LIST_DIR}/mingw-common.cmake)
find_program(KARVEL_WINE wine REQUIRED)
set(CMAKE_CROSSCOMPILING_EMULATOR ${KARVEL_WINE})
