# SPDX-License-Identifier: Apache-2.0
# Builds for 32-bit ARM Linux (armhf) with Debian's cross compiler, against the
# sysroot that tools/sysroot makes, and runs what is built in the emulator.

set(ORV_SYSROOT ${CMAKE_BINARY_DIR}/sysroot CACHE PATH "The sysroot, from tools/sysroot")
# Try-compile projects read this file too, in folders of their own.
list(APPEND CMAKE_TRY_COMPILE_PLATFORM_VARIABLES ORV_SYSROOT)

set(CMAKE_SYSTEM_NAME Linux)
set(CMAKE_SYSTEM_PROCESSOR arm)
set(CMAKE_C_COMPILER arm-linux-gnueabihf-gcc)
set(CMAKE_CXX_COMPILER arm-linux-gnueabihf-g++)
set(CMAKE_LIBRARY_ARCHITECTURE arm-linux-gnueabihf)
set(CMAKE_SYSROOT ${ORV_SYSROOT})

set(orv_library_dir ${ORV_SYSROOT}/usr/lib/${CMAKE_LIBRARY_ARCHITECTURE})
# The linker must find what the sysroot's libraries need in turn; blas and
# lapack stand in folders that a set-up system would link to.
set(orv_runtime_dirs
  ${orv_library_dir}/android
  ${orv_library_dir}/pulseaudio
  ${orv_library_dir}/blas
  ${orv_library_dir}/lapack)
foreach(directory ${orv_library_dir} ${orv_runtime_dirs})
  string(APPEND CMAKE_EXE_LINKER_FLAGS_INIT " \"-Wl,-rpath-link,${directory}\"")
  string(APPEND CMAKE_SHARED_LINKER_FLAGS_INIT " \"-Wl,-rpath-link,${directory}\"")
endforeach()

# The compiler would note at every vector that its calls changed in version 7.
# Times are 32 bits wide on the target; Debian's own have 64 from release 13 on.
set(CMAKE_CXX_FLAGS_INIT "-Wno-psabi -U_TIME_BITS")

# Programs are the host's, everything else is the sysroot's.
set(CMAKE_FIND_ROOT_PATH_MODE_PROGRAM NEVER)
set(CMAKE_FIND_ROOT_PATH_MODE_LIBRARY ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_INCLUDE ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_PACKAGE ONLY)
set(ENV{PKG_CONFIG_SYSROOT_DIR} ${ORV_SYSROOT})
set(ENV{PKG_CONFIG_LIBDIR} ${orv_library_dir}/pkgconfig:${ORV_SYSROOT}/usr/share/pkgconfig)

list(JOIN orv_runtime_dirs ":" orv_runtime_path)
set(CMAKE_CROSSCOMPILING_EMULATOR
  qemu-arm -L ${ORV_SYSROOT} -E LD_LIBRARY_PATH=${orv_runtime_path})
# The virtual machine that the Java tests run on. A 32-bit program cannot list
# folders of the usual file systems in the emulator, so its temporary files go
# to memory. It starts other programs without its helper program, which only the
# emulator could run; and not by vfork, which the emulator carries out as a fork
# that leaves the locks of other threads held: the child hangs. With Java's own
# choice of heap and compilers, the emulated optimizing compiler now and then ran
# out of memory with most of the address space free; smaller ones do not.
set(ORV_JAVA_RUNTIME
  ${CMAKE_CROSSCOMPILING_EMULATOR} ${ORV_SYSROOT}/usr/lib/jvm/default-java/bin/java
  -Xmx256m -XX:ReservedCodeCacheSize=48m -XX:TieredStopAtLevel=1
  -Djava.io.tmpdir=/dev/shm -Djdk.lang.Process.launchMechanism=FORK)
# Emulated programs are slow to start: their tests are listed when ctest runs.
set(CMAKE_GTEST_DISCOVER_TESTS_DISCOVERY_MODE PRE_TEST)
