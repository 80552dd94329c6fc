# SPDX-License-Identifier: Apache-2.0
# The Java modules that programs use: those whose API abi/java-api.txt describes and
# with which the documentation's programs are compiled. A target that is not built
# is left out.
set(ORV_JAVA_MODULES orv_platform_java mediaplayer_orv_java mediaplayer_orv_testing)

# Names their JARs in java/modules.txt, for tools, and makes the target java_modules,
# which builds them.
function(orv_java_modules)
  foreach(target ${ORV_JAVA_MODULES})
    if(TARGET ${target})
      get_target_property(jar ${target} JAR_FILE)
      list(APPEND targets ${target})
      string(APPEND text "described ${jar}\n")
    endif()
  endforeach()
  string(APPEND text "needed ${ANNOTATIONS_JAR}\n")
  file(CONFIGURE OUTPUT ${CMAKE_BINARY_DIR}/java/modules.txt CONTENT "${text}" @ONLY)
  add_custom_target(java_modules DEPENDS ${targets})
endfunction()
