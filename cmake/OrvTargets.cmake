# SPDX-License-Identifier: Apache-2.0
# What every native target of this project is compiled with.

set(CMAKE_CXX_STANDARD 17)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_EXPORT_COMPILE_COMMANDS ON)
set(CMAKE_POSITION_INDEPENDENT_CODE ON)
set(CMAKE_LIBRARY_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/lib)
set(CMAKE_RUNTIME_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/bin)
if(NOT CMAKE_BUILD_TYPE)
  set(CMAKE_BUILD_TYPE RelWithDebInfo)
endif()

add_library(orv_warnings INTERFACE)
target_compile_options(orv_warnings INTERFACE -Wall -Wextra)

# Warnings end the build of those who change the project, by
# CMAKE_COMPILE_WARNING_AS_ERROR; others may have a compiler that finds more.
# Texts are put together by plain code: what javac does otherwise is linked at each
# start anew.
set(ORV_JAVA_FLAGS --release 17 -encoding UTF-8 -Xlint:all -XDstringConcat=inline)
if(CMAKE_COMPILE_WARNING_AS_ERROR)
  list(APPEND ORV_JAVA_FLAGS -Werror)
endif()

include(AndroidPackages)
set(CMAKE_BUILD_RPATH ${ANDROID_LIBRARY_DIR})
find_package(Threads REQUIRED)

# Has all functions of a library be found when it is linked. A sanitizer's are the
# program's alone.
function(orv_refuse_undefined library)
  if(NOT CMAKE_CXX_FLAGS MATCHES "-fsanitize")
    target_link_options(${library} PRIVATE LINKER:--no-undefined)
  endif()
endfunction()
