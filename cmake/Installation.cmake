# Where the build is installed, and the target `uninstall`. An installed tree works wherever it is moved to: libraries
# find each other relative to where they stand, and cimomd its classes and providers (cimom/configuration/).
if(NOT CMAKE_INSTALL_DOCDIR)
  set(CMAKE_INSTALL_DOCDIR "share/doc/compositeipconfig" CACHE PATH "Samples and licences")
endif()
include(GNUInstallDirs)

install(FILES LICENSE DESTINATION "${CMAKE_INSTALL_DOCDIR}" COMPONENT library)

# A library that others are linked against, or that the agent loads.
function(install_agent_library target component)
  set_target_properties(${target} PROPERTIES INSTALL_RPATH "$ORIGIN")
  install(TARGETS ${target} LIBRARY DESTINATION "${CMAKE_INSTALL_LIBDIR}" COMPONENT ${component})
endfunction()

# A library that object managers load. They look for lib<location>.so in their provider directories: the link stands
# beside the library.
function(install_provider target component)
  set_target_properties(${target} PROPERTIES INSTALL_RPATH "$ORIGIN/..")
  install(TARGETS ${target} LIBRARY DESTINATION "${CMAKE_INSTALL_LIBDIR}/cmpi" COMPONENT ${component})
endfunction()

# Our own directories, which go with the last file in them: the deepest first.
set(shared "${CMAKE_INSTALL_DATADIR}/compositeipconfig")
set(own "${CMAKE_INSTALL_LIBDIR}/cmpi" "${shared}/cimomd" "${shared}/sfcb" "${shared}/pegasus" "${shared}"
        "${CMAKE_INSTALL_DOCDIR}")
add_custom_target(
  uninstall
  COMMAND "${CMAKE_COMMAND}" "-DBINARY_DIR=${PROJECT_BINARY_DIR}" "-DOWN_DIRECTORIES=${own}" -P
          "${PROJECT_SOURCE_DIR}/cmake/Uninstall.cmake"
  COMMENT "Removing what was installed last from this build"
  VERBATIM)
