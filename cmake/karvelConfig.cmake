# find_package(karvel): the imported target karvel::karvel (karvel.dll, its import library, the
# include folder for <karvel/karvel.h> and the Windows libraries it uses).
include(${CMAKE_CURRENT_LIST_DIR}/karvelTargets.cmake)
