# The CMPI headers as the target `cmpi`: -DCMPI_INCLUDE_DIR=, else a system's own cmpidt.h, else the project's cmpi/.
if(NOT CMPI_INCLUDE_DIR)
  find_path(SYSTEM_CMPI_INCLUDE_DIR cmpidt.h PATH_SUFFIXES cmpi)
  if(SYSTEM_CMPI_INCLUDE_DIR)
    set(CMPI_HEADERS "${SYSTEM_CMPI_INCLUDE_DIR}")
  else()
    set(CMPI_HEADERS "${PROJECT_SOURCE_DIR}/cmpi")
  endif()
else()
  set(CMPI_HEADERS "${CMPI_INCLUDE_DIR}")
endif()
foreach(header cmpidt.h cmpift.h cmpimacs.h)
  if(NOT EXISTS "${CMPI_HEADERS}/${header}")
    message(FATAL_ERROR "${CMPI_HEADERS} has no ${header}: name the directory of all CMPI headers with "
                        "-DCMPI_INCLUDE_DIR=, for example ${PROJECT_SOURCE_DIR}/cmpi")
  endif()
endforeach()
message(STATUS "CMPI headers: ${CMPI_HEADERS}")

# What differs between the sets is levelled in compatible/, which includes them in turn. SYSTEM: the convenience macros
# cast in C's manner.
add_library(cmpi INTERFACE)
target_include_directories(cmpi SYSTEM INTERFACE "${PROJECT_SOURCE_DIR}/cmpi/compatible" "${CMPI_HEADERS}")
target_compile_definitions(cmpi INTERFACE CMPI_PLATFORM_LINUX_GENERIC_GNU)
