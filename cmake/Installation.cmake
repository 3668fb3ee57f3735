# Where the build is installed, and the target `uninstall`. An installed tree works wherever it is moved to: libraries
# find each other relative to where they stand, and cimomd its classes and providers (cimom/configuration/).
if(NOT CMAKE_INSTALL_DOCDIR)
  set(CMAKE_INSTALL_DOCDIR "share/doc/compositeipconfig")
endif()
include(GNUInstallDirs)

install(FILES LICENSE DESTINATION "${CMAKE_INSTALL_DOCDIR}" COMPONENT library)

# A library that others are linked against.
function(install_agent_library target component)
  set_target_properties(${target} PROPERTIES INSTALL_RPATH "$ORIGIN")
  install(TARGETS ${target} LIBRARY DESTINATION "${CMAKE_INSTALL_LIBDIR}" COMPONENT ${component})
endfunction()

# A library that the agent loads (agent/backends/SharedBackEnd.cpp).
function(install_back_end target component)
  set_target_properties(${target} PROPERTIES INSTALL_RPATH "$ORIGIN/..")
  install(TARGETS ${target} LIBRARY DESTINATION "${CMAKE_INSTALL_LIBDIR}/compositeipconfig" COMPONENT ${component})
endfunction()

# A library that object managers load. They look for lib<location>.so in their provider directories: the link stands
# beside the library.
function(install_provider target component)
  set_target_properties(${target} PROPERTIES INSTALL_RPATH "$ORIGIN/..")
  install(TARGETS ${target} LIBRARY DESTINATION "${CMAKE_INSTALL_LIBDIR}/cmpi" COMPONENT ${component})
endfunction()

add_custom_target(uninstall COMMAND "${PROJECT_SOURCE_DIR}/tools/uninstall" "${PROJECT_BINARY_DIR}" VERBATIM USES_TERMINAL)
