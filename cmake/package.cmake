# karvel.dll as a host gets it: the exported classes, a version resource, the public headers and
# the CMake package (find_package(karvel) gives karvel::karvel). Included by the top CMakeLists.
include(GNUInstallDirs)
include(CMakePackageConfigHelpers)

# The public headers: the exported classes and the records they take. They include only each
# other, by paths relative to themselves, so the same files serve the source and install trees.
set(KARVEL_PUBLIC_HEADERS
  model/export.h model/platform.h model/dor_array.h model/dor_types.h model/dor_list.h
  model/vel_primitive.h
  camera/vel_camera.h camera/vel_math_camera.h
  convert/dor_shape.h convert/vel_group_array.h convert/vel_shape_to_primitive.h
  convert/vel_polygon_to_primitive.h convert/vel_hole_polygon_to_primitive.h
  convert/vel_extruded_to_primitive.h convert/vel_hole_extruded_to_primitive.h
  primitives/vel_math_primitive.h
  gl/vel_karvel.h gl/vel_gl_karvel.h gl/vel_gl_context.h gl/vel_gl_render_state.h gl/vel_gl_store.h
  movie/vfw_math_movie.h)

enable_language(RC)
configure_file(${CMAKE_CURRENT_LIST_DIR}/karvel.rc.in ${CMAKE_CURRENT_BINARY_DIR}/karvel.rc @ONLY)

add_library(karvel SHARED ${KARVEL_SOURCES} ${CMAKE_CURRENT_BINARY_DIR}/karvel.rc)
add_library(karvel::karvel ALIAS karvel)
target_compile_definitions(karvel PRIVATE KARVEL_BUILD)
target_include_directories(karvel PRIVATE ${CMAKE_CURRENT_SOURCE_DIR})
target_link_libraries(karvel PUBLIC ${KARVEL_SYSTEM_LIBS})
set_target_properties(karvel PROPERTIES PREFIX "" OUTPUT_NAME karvel)

# <karvel/karvel.h> from the build tree, for hosts that add this tree with add_subdirectory.
set(karvel_build_include ${CMAKE_CURRENT_BINARY_DIR}/include)
file(CONFIGURE OUTPUT ${karvel_build_include}/karvel/karvel.h
     CONTENT "#pragma once\n#include \"${CMAKE_CURRENT_SOURCE_DIR}/karvel.h\"\n")
target_include_directories(karvel INTERFACE $<BUILD_INTERFACE:${karvel_build_include}>
                                            $<INSTALL_INTERFACE:${CMAKE_INSTALL_INCLUDEDIR}>)

install(TARGETS karvel EXPORT karvelTargets
        RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR}
        LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}
        ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR})
install(FILES karvel.h DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/karvel)
foreach(header ${KARVEL_PUBLIC_HEADERS})
  get_filename_component(folder ${header} DIRECTORY)
  install(FILES ${header} DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/karvel/${folder})
endforeach()
install(FILES LICENSE DESTINATION ${CMAKE_INSTALL_DATAROOTDIR}/doc/karvel)

set(karvel_cmake_dir ${CMAKE_INSTALL_LIBDIR}/cmake/karvel)
install(EXPORT karvelTargets NAMESPACE karvel:: DESTINATION ${karvel_cmake_dir})
# The version file also refuses a package built for the other pointer size.
write_basic_package_version_file(${CMAKE_CURRENT_BINARY_DIR}/karvelConfigVersion.cmake
                                 COMPATIBILITY SameMajorVersion)
install(FILES ${CMAKE_CURRENT_LIST_DIR}/karvelConfig.cmake ${CMAKE_CURRENT_BINARY_DIR}/karvelConfigVersion.cmake
        DESTINATION ${karvel_cmake_dir})
