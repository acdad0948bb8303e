# Cross build for 64-bit Windows; programs run under Wine.
set(CMAKE_SYSTEM_NAME Windows)
set(CMAKE_SYSTEM_PROCESSOR x86_64)
set(KARVEL_MINGW_PREFIX x86_64-w64-mingw32)
include(${CMAKE_CURRENT_LIST_DIR}/mingw-common.cmake)
find_program(KARVEL_WINE wine REQUIRED)
set(CMAKE_CROSSCOMPILING_EMULATOR ${KARVEL_WINE})
