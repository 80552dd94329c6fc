# SPDX-License-Identifier: Apache-2.0
# The platform libraries that Debian packages: utils, log and nativehelper, as the
# target android_packages. Read by this project's build and, installed, by the
# programs that find_package it.
if(TARGET android_packages)
  return()
endif()

# Their headers warn, so they are system headers; jni.h stands in a folder of its own.
find_path(ANDROID_INCLUDE_DIR utils/RefBase.h PATH_SUFFIXES android REQUIRED)
foreach(name utils log nativehelper)
  string(TOUPPER ${name} upper)
  find_library(ANDROID_${upper}_LIBRARY ${name}
    PATH_SUFFIXES android ${CMAKE_LIBRARY_ARCHITECTURE}/android REQUIRED)
endforeach()
# By their paths, from which CMake makes the run-time path of programs, too.
add_library(android_packages INTERFACE IMPORTED)
set_target_properties(android_packages PROPERTIES
  INTERFACE_INCLUDE_DIRECTORIES "${ANDROID_INCLUDE_DIR};${ANDROID_INCLUDE_DIR}/nativehelper"
  INTERFACE_LINK_LIBRARIES
    "${ANDROID_UTILS_LIBRARY};${ANDROID_LOG_LIBRARY};${ANDROID_NATIVEHELPER_LIBRARY}")
get_filename_component(ANDROID_LIBRARY_DIR ${ANDROID_UTILS_LIBRARY} DIRECTORY)
