# The sample viewer's portable core: scene files, BMP textures, PNG pictures, the command line.
# Its sources are compiled into each program that links it, with that program's flags, so the
# same files serve the viewer (through the DLL) and the test programs (through the static
# library). Included by examples/ and tests/; whichever comes first defines it.
if(NOT TARGET karvel_viewer_core)
  # NOTE: nlohmann-json and stb are header-only; Debian puts them in /usr/include, which a MinGW
  # build must not search as a whole. Copies in the build tree keep them apart (copies, not
  # links: links need extra rights on Windows).
  if(NOT KARVEL_NLOHMANN_INCLUDE OR NOT KARVEL_STB_INCLUDE)
    message(FATAL_ERROR "The viewer needs nlohmann/json.hpp and stb/stb_image_write.h "
                        "(Debian: nlohmann-json3-dev libstb-dev)")
  endif()
  set(viewer_third_party ${CMAKE_BINARY_DIR}/third_party/headers)
  file(COPY ${KARVEL_NLOHMANN_INCLUDE}/nlohmann DESTINATION ${viewer_third_party})
  file(COPY ${KARVEL_STB_INCLUDE}/stb/stb_image_write.h ${KARVEL_STB_INCLUDE}/stb/stb_image.h
       DESTINATION ${viewer_third_party}/stb)

  file(GLOB viewer_core_sources CONFIGURE_DEPENDS ${PROJECT_SOURCE_DIR}/examples/viewer/*.cpp)
  karvel_split_sources(viewer_core_portable viewer_core_windows ${viewer_core_sources})
  add_library(karvel_viewer_core INTERFACE)
  target_sources(karvel_viewer_core INTERFACE ${viewer_core_portable})
  target_include_directories(karvel_viewer_core INTERFACE ${PROJECT_SOURCE_DIR}/examples/viewer)
  target_include_directories(karvel_viewer_core SYSTEM INTERFACE ${viewer_third_party})
endif()
