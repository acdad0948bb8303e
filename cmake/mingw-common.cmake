# NOTE: the -posix compilers: the win32 thread model lacks std::thread and std::mutex, which
# GoogleTest needs.
set(CMAKE_C_COMPILER ${KARVEL_MINGW_PREFIX}-gcc-posix)
set(CMAKE_CXX_COMPILER ${KARVEL_MINGW_PREFIX}-g++-posix)
set(CMAKE_RC_COMPILER ${KARVEL_MINGW_PREFIX}-windres)
set(CMAKE_FIND_ROOT_PATH /usr/${KARVEL_MINGW_PREFIX})
set(CMAKE_FIND_ROOT_PATH_MODE_PROGRAM NEVER)
set(CMAKE_FIND_ROOT_PATH_MODE_LIBRARY ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_INCLUDE ONLY)
# The host's own packages (its GoogleTest, say) are not for Windows.
set(CMAKE_FIND_ROOT_PATH_MODE_PACKAGE ONLY)
# Static runtime: the DLL and the programs import nothing but system DLLs.
set(CMAKE_EXE_LINKER_FLAGS_INIT "-static")
set(CMAKE_SHARED_LINKER_FLAGS_INIT "-static")
