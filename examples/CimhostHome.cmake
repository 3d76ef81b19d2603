# cimhost_home(<name> DEFINITIONS file... PLUGINS target... NAMESPACE namespace CLASSES file...)
#
# Lays out ${CMAKE_BINARY_DIR}/home/<name> as a home directory for `cimhost --home`, with the target
# <name>_home, which is part of "all":
#
#   run/   definition files          lib/   plug-ins, as links to the build's own
#   logs/  empty                     mof/<namespace>/   class declarations
function(cimhost_home name)
  cmake_parse_arguments(ARG "" "NAMESPACE" "DEFINITIONS;PLUGINS;CLASSES" ${ARGN})
  set(home "${CMAKE_BINARY_DIR}/home/${name}")
  set(made "")

  foreach(file IN LISTS ARG_DEFINITIONS)
    get_filename_component(base "${file}" NAME)
    _cimhost_home_file("${file}" "${home}/run/${base}")
    list(APPEND made "${home}/run/${base}")
  endforeach()
  foreach(file IN LISTS ARG_CLASSES)
    get_filename_component(base "${file}" NAME)
    _cimhost_home_file("${file}" "${home}/mof/${ARG_NAMESPACE}/${base}")
    list(APPEND made "${home}/mof/${ARG_NAMESPACE}/${base}")
  endforeach()

  set(links "")
  foreach(plugin IN LISTS ARG_PLUGINS)
    list(APPEND links COMMAND ${CMAKE_COMMAND} -E create_symlink
      "$<TARGET_FILE:${plugin}>" "${home}/lib/$<TARGET_FILE_NAME:${plugin}>")
  endforeach()
  add_custom_target(${name}_home ALL
    COMMAND ${CMAKE_COMMAND} -E make_directory "${home}/lib" "${home}/logs"
    ${links}
    DEPENDS ${made}
    COMMENT "Home directory home/${name}"
    VERBATIM)
  if(ARG_PLUGINS)
    add_dependencies(${name}_home ${ARG_PLUGINS})
  endif()
endfunction()

function(_cimhost_home_file from to)
  get_filename_component(from "${from}" ABSOLUTE)
  get_filename_component(folder "${to}" DIRECTORY)
  add_custom_command(OUTPUT "${to}"
    COMMAND ${CMAKE_COMMAND} -E make_directory "${folder}"
    COMMAND ${CMAKE_COMMAND} -E copy "${from}" "${to}"
    DEPENDS "${from}"
    VERBATIM)
endfunction()
