# SPDX-License-Identifier: Apache-2.0
# Manual pages and bash completions of the player, from what describes its arguments.
option(ORV_MANUALS "Make the player's manual pages (needs help2man) and completions" OFF)

# orv_install_manuals(PLAYER_TARGET)
function(orv_install_manuals player)
  find_program(HELP2MAN help2man REQUIRED)
  set(from ${PROJECT_SOURCE_DIR}/cmake/manuals)
  set(folder ${PROJECT_BINARY_DIR}/install)
  file(MAKE_DIRECTORY ${folder}/man)

  set(play "play media in a window or in the terminal")
  set(info "what media hold: tracks, chapters, metadata")
  set(thumbnail "one picture of a video")
  set(cover "the embedded picture of media")
  set(manuals ${folder}/man/orv.1)
  orv_manual(orv ${folder}/orv "play, describe and picture media")
  foreach(command play info thumbnail cover)
    configure_file(${from}/orv-command.in ${folder}/man/orv-${command} @ONLY
      FILE_PERMISSIONS OWNER_READ OWNER_WRITE OWNER_EXECUTE)
    orv_manual(orv-${command} ${folder}/man/orv-${command} "${${command}}")
    list(APPEND manuals ${folder}/man/orv-${command}.1)
  endforeach()

  set(more_completion)
  if(TARGET orv_trace)
    orv_manual(orv-trace $<TARGET_FILE:orv_trace> "how long the native methods of a player took, from a log")
    list(APPEND manuals ${folder}/man/orv-trace.1)
    set(more_completion ${from}/trace-completion.bash)
  endif()

  set(completion ${folder}/completion/orv)
  add_custom_command(OUTPUT ${completion}
    COMMAND ${CMAKE_COMMAND} -E make_directory ${folder}/completion/classes
    COMMAND ${Java_JAVAC_EXECUTABLE} ${ORV_JAVA_FLAGS} -proc:none -Xlint:-path
      -cp ${PROJECT_BINARY_DIR}/java/orv_player.jar -d ${folder}/completion/classes
      ${from}/java/Completion.java
    COMMAND ${Java_JAVA_EXECUTABLE}
      -cp ${PROJECT_BINARY_DIR}/java/orv_player.jar:${folder}/completion/classes
      com.quintora.orv.player.Completion ${completion} ${more_completion}
    DEPENDS ${player} ${PROJECT_BINARY_DIR}/java/orv_player.jar ${from}/java/Completion.java ${more_completion})

  add_custom_target(orv_manuals ALL DEPENDS ${manuals} ${completion})
  install(FILES ${manuals} DESTINATION ${CMAKE_INSTALL_MANDIR}/man1 COMPONENT player)
  install(FILES ${completion} DESTINATION ${CMAKE_INSTALL_DATADIR}/bash-completion/completions
    COMPONENT player)
endfunction()

# orv_manual(NAME PROGRAM SUMMARY): from what the program says for --help.
function(orv_manual name program summary)
  set(include ${PROJECT_SOURCE_DIR}/cmake/manuals/common.h2m)
  add_custom_command(OUTPUT ${PROJECT_BINARY_DIR}/install/man/${name}.1
    COMMAND ${HELP2MAN} --no-info --no-discard-stderr --section 1 --locale C.UTF-8
      --name ${summary} --manual "User Commands" --source "orv ${PROJECT_VERSION}"
      --version-string "${PROJECT_VERSION}" --include ${include}
      --output ${PROJECT_BINARY_DIR}/install/man/${name}.1 ${program}
    DEPENDS orv_player ${PROJECT_BINARY_DIR}/java/orv_player.jar ${program} ${include})
endfunction()
