# SPDX-License-Identifier: Apache-2.0
# What cmake --install puts where. Everything finds everything else by relative
# paths, so that the prefix can be moved. Components: runtime, engine, java, player,
# dev, doc.
include(GNUInstallDirs)
include(CMakePackageConfigHelpers)
include(OrvManuals)

set(ORV_INSTALL_LIBDIR ${CMAKE_INSTALL_LIBDIR} CACHE STRING
  "Where the libraries go, below the prefix")
option(ORV_BUNDLE_JARS "Install copies of the player's picocli, gson and JNA, not links to the system's" ON)
option(ORV_RELOCATABLE "pkg-config's files find the prefix from their own place" ON)
set(ORV_JAVADIR ${CMAKE_INSTALL_DATADIR}/java)
set(ORV_PLAYERDIR ${CMAKE_INSTALL_DATADIR}/orv-player)
set(ORV_LIBEXECDIR ${CMAKE_INSTALL_LIBEXECDIR}/orv)
set(ORV_HEADERDIR ${CMAKE_INSTALL_INCLUDEDIR}/mediaplayer_orv)
set(ORV_CMAKEDIR ${CMAKE_INSTALL_LIBDIR}/cmake/mediaplayer_orv)
set(ORV_PKGCONFIGDIR ${CMAKE_INSTALL_LIBDIR}/pkgconfig)

# Each other beside themselves, Debian's Android libraries where those are.
string(REPLACE "${CMAKE_SYSROOT}" "" android_library_dir "${ANDROID_LIBRARY_DIR}")
set(CMAKE_INSTALL_RPATH "$ORIGIN;${android_library_dir}")

# orv_install_library(TARGET COMPONENT EXPORT_NAME): also as mediaplayer_orv::EXPORT_NAME
# for programs that find_package this project.
function(orv_install_library target component name)
  set_target_properties(${target} PROPERTIES EXPORT_NAME ${name})
  # The name without a version is no link for developers alone: Java loads by it.
  install(TARGETS ${target} EXPORT mediaplayer_orv
    LIBRARY DESTINATION ${ORV_INSTALL_LIBDIR} COMPONENT ${component})
endfunction()

# orv_install_headers(DIRECTORY FILE…): with no FILE all headers below the directory.
function(orv_install_headers directory)
  if(NOT ARGN)
    install(DIRECTORY ${directory}/ DESTINATION ${ORV_HEADERDIR} COMPONENT dev
      FILES_MATCHING PATTERN *.h)
  endif()
  foreach(file ${ARGN})
    cmake_path(GET file PARENT_PATH folder)
    install(FILES ${directory}/${file} DESTINATION ${ORV_HEADERDIR}/${folder} COMPONENT dev)
  endforeach()
endfunction()

# orv_install_jar(TARGET [FOR_PLAYER]): FOR_PLAYER also where the player's jar looks for
# those that it needs: beside itself.
function(orv_install_jar target)
  install_jar(${target} DESTINATION ${ORV_JAVADIR} COMPONENT java)
  if(FOR_PLAYER IN_LIST ARGN AND ORV_ENGINE)
    get_target_property(jar ${target} JAR_FILE)
    cmake_path(GET jar FILENAME jar)
    file(RELATIVE_PATH up /prefix/${ORV_PLAYERDIR} /prefix/${ORV_JAVADIR})
    orv_install_link(${up}/${jar} ${ORV_PLAYERDIR}/${jar} player)
  endif()
endfunction()

# orv_install_link(TO NAME COMPONENT)
function(orv_install_link to name component)
  cmake_path(GET name PARENT_PATH folder)
  install(CODE "
    set(folder \"\$ENV{DESTDIR}\${CMAKE_INSTALL_PREFIX}/${folder}\")
    file(MAKE_DIRECTORY \"\${folder}\")
    message(STATUS \"Installing: \$ENV{DESTDIR}\${CMAKE_INSTALL_PREFIX}/${name}\")
    file(CREATE_LINK \"${to}\" \"\$ENV{DESTDIR}\${CMAKE_INSTALL_PREFIX}/${name}\" SYMBOLIC)
    list(APPEND CMAKE_INSTALL_MANIFEST_FILES \"\${CMAKE_INSTALL_PREFIX}/${name}\")"
    COMPONENT ${component})
endfunction()

# orv_install_player(TARGET JAR…): the player's jar, those JARs that it needs besides
# FOR_PLAYER ones, and the command that starts it.
function(orv_install_player target)
  install_jar(${target} DESTINATION ${ORV_PLAYERDIR} COMPONENT player)
  foreach(jar ${ARGN})
    # Its name here is without the version that a link to it leads to.
    cmake_path(GET jar FILENAME name)
    if(ORV_BUNDLE_JARS)
      file(REAL_PATH ${jar} file)
      install(FILES ${file} DESTINATION ${ORV_PLAYERDIR} RENAME ${name} COMPONENT player)
    else()
      orv_install_link(${jar} ${ORV_PLAYERDIR}/${name} player)
    endif()
  endforeach()
  if(TARGET orv_trace)
    set_target_properties(orv_trace PROPERTIES INSTALL_RPATH "")
    install(TARGETS orv_trace DESTINATION ${ORV_LIBEXECDIR} COMPONENT player)
  endif()
  install(FILES ${PROJECT_SOURCE_DIR}/tools/shell/launch.sh ${PROJECT_SOURCE_DIR}/tools/shell/sound.sh
    DESTINATION ${ORV_PLAYERDIR} COMPONENT player)
  install(PROGRAMS ${PROJECT_SOURCE_DIR}/tools/make-sample DESTINATION ${ORV_PLAYERDIR} COMPONENT player)
  set(version "${PROJECT_VERSION}")
  file(RELATIVE_PATH player /prefix/${CMAKE_INSTALL_BINDIR} /prefix/${ORV_PLAYERDIR})
  file(RELATIVE_PATH libraries /prefix/${CMAKE_INSTALL_BINDIR} /prefix/${ORV_INSTALL_LIBDIR})
  file(RELATIVE_PATH trace /prefix/${CMAKE_INSTALL_BINDIR} /prefix/${ORV_LIBEXECDIR}/orv-trace)
  configure_file(${PROJECT_SOURCE_DIR}/cmake/orv.in ${PROJECT_BINARY_DIR}/install/orv @ONLY
    FILE_PERMISSIONS OWNER_READ OWNER_WRITE OWNER_EXECUTE)
  install(PROGRAMS ${PROJECT_BINARY_DIR}/install/orv DESTINATION ${CMAKE_INSTALL_BINDIR} COMPONENT player)

  set(desktop ${PROJECT_SOURCE_DIR}/cmake/desktop/com.quintora.orv.player)
  install(FILES ${desktop}.desktop DESTINATION ${CMAKE_INSTALL_DATADIR}/applications COMPONENT player)
  install(FILES ${desktop}.svg DESTINATION ${CMAKE_INSTALL_DATADIR}/icons/hicolor/scalable/apps
    COMPONENT player)
  if(ORV_MANUALS)
    orv_install_manuals(${target})
  endif()
endfunction()

# For who builds against what was installed: a CMake package, and pkg-config's files,
# both with paths from their own place.
function(orv_install_packages)
  install(EXPORT mediaplayer_orv FILE mediaplayer_orv-targets.cmake
    NAMESPACE mediaplayer_orv:: DESTINATION ${ORV_CMAKEDIR} COMPONENT dev)
  set(config ${PROJECT_BINARY_DIR}/install/mediaplayer_orv-config.cmake)
  configure_package_config_file(${PROJECT_SOURCE_DIR}/cmake/mediaplayer_orv-config.cmake.in ${config}
    INSTALL_DESTINATION ${ORV_CMAKEDIR} PATH_VARS ORV_JAVADIR)
  write_basic_package_version_file(${PROJECT_BINARY_DIR}/install/mediaplayer_orv-config-version.cmake
    COMPATIBILITY SameMajorVersion)
  install(FILES ${config} ${PROJECT_BINARY_DIR}/install/mediaplayer_orv-config-version.cmake
    ${PROJECT_SOURCE_DIR}/cmake/AndroidPackages.cmake
    DESTINATION ${ORV_CMAKEDIR} COMPONENT dev)
  orv_install_pkgconfig(orv_platform "The platform for desktop Linux" "" orv_platform)
  if(TARGET orvtarn)
    orv_install_pkgconfig(orvtarn "The desktop's playback engine" orv_platform orvtarn)
  endif()
  if(TARGET mediaplayer_orv)
    orv_install_pkgconfig(mediaplayer_orv "The native half of a Java media player" "orvtarn" mediaplayer_orv)
  endif()
endfunction()

# orv_install_pkgconfig(NAME DESCRIPTION REQUIRES LIBRARY)
function(orv_install_pkgconfig name description requires library)
  file(RELATIVE_PATH prefix /prefix/${ORV_PKGCONFIGDIR} /prefix)
  string(REGEX REPLACE "/$" "" prefix "\${pcfiledir}/${prefix}")
  # Then no program's run-time path goes by way of a folder that developers alone have.
  if(NOT ORV_RELOCATABLE)
    set(prefix ${CMAKE_INSTALL_PREFIX})
  endif()
  set(libraries -l${library})
  set(android_flags)
  set(android_libraries)
  if(NOT requires)
    string(REPLACE "${CMAKE_SYSROOT}" "" include "${ANDROID_INCLUDE_DIR}")
    set(android_flags "-isystem ${include} -isystem ${include}/nativehelper")
    set(android_libraries
      "-L${android_library_dir} -lutils -llog -lnativehelper -Wl,-rpath,${android_library_dir}")
  endif()
  set(file ${PROJECT_BINARY_DIR}/install/${name}.pc)
  configure_file(${PROJECT_SOURCE_DIR}/cmake/pkgconfig.in ${file} @ONLY)
  install(FILES ${file} DESTINATION ${ORV_PKGCONFIGDIR} COMPONENT dev)
endfunction()

install(FILES README.md CHANGELOG.md LICENSE DESTINATION ${CMAKE_INSTALL_DOCDIR} COMPONENT doc)
install(DIRECTORY docs DESTINATION ${CMAKE_INSTALL_DOCDIR} COMPONENT doc)
