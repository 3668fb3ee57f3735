# The CMPI headers as the target `cmpi`: -DCMPI_INCLUDE_DIR=, else a system's own cmpidt.h, else the project's cmpi/.
if(NOT CMPI_INCLUDE_DIR)
  find_path(SYSTEM_CMPI_INCLUDE_DIR cmpidt.h PATH_SUFFIXES cmpi)
  if(SYSTEM_CMPI_INCLUDE_DIR)
    set(CMPI_HEADERS "${SYSTEM_CMPI_INCLUDE_DIR}")
  else()
    set(CMPI_HEADERS "${PROJECT_SOURCE_DIR}/cmpi")
  endif()
elseif(EXISTS "${CMPI_INCLUDE_DIR}/cmpidt.h")
  set(CMPI_HEADERS "${CMPI_INCLUDE_DIR}")
else()
  message(FATAL_ERROR "CMPI_INCLUDE_DIR is ${CMPI_INCLUDE_DIR}, but there is no cmpidt.h in it")
endif()
message(STATUS "CMPI headers: ${CMPI_HEADERS}")

# SYSTEM: the convenience macros cast in C's manner.
add_library(cmpi INTERFACE)
target_include_directories(cmpi SYSTEM INTERFACE "${CMPI_HEADERS}")
target_compile_definitions(cmpi INTERFACE CMPI_PLATFORM_LINUX_GENERIC_GNU)
