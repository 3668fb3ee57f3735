# The management agent that the library is built against: the project's own (agent/), or another set of libraries with
# the same interfaces, headers under AGENT_ROOT/include and libraries under AGENT_ROOT/lib.
if(AGENT_ROOT)
  foreach(library qvhelper qvinstrumentation twlog)
    find_library(AGENT_${library} ${library} PATHS "${AGENT_ROOT}/lib" NO_DEFAULT_PATH REQUIRED)
    list(APPEND AGENT_LIBRARIES "${AGENT_${library}}")
  endforeach()
  set(AGENT_INCLUDE_DIR "${AGENT_ROOT}/include")
else()
  set(AGENT_LIBRARIES qvhelper qvinstrumentation twlog)
  set(AGENT_INCLUDE_DIR "${PROJECT_SOURCE_DIR}/agent/include")
endif()

add_library(agent_interface INTERFACE)
target_include_directories(agent_interface INTERFACE "${AGENT_INCLUDE_DIR}")
target_link_libraries(agent_interface INTERFACE cmpi)
