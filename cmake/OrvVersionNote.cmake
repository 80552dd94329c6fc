# SPDX-License-Identifier: Apache-2.0
# Links a note with the project's version into a library, for the Java half to
# compare with its own. It stands beside the library's sources, which a platform
# tree builds without it.

function(orv_add_version_note target)
  set(note ${CMAKE_CURRENT_BINARY_DIR}/${target}-version-note.cpp)
  configure_file(${CMAKE_SOURCE_DIR}/cmake/version-note.cpp.in ${note} @ONLY)
  target_sources(${target} PRIVATE ${note})
endfunction()
