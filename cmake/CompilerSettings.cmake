# Settings that every target shares: C++20, warnings (errors with the presets), hidden symbols, sanitizers, coverage.
set(CMAKE_CXX_STANDARD 20)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_CXX_VISIBILITY_PRESET hidden)
set(CMAKE_VISIBILITY_INLINES_HIDDEN ON)
set(CMAKE_POSITION_INDEPENDENT_CODE ON)
set(CMAKE_EXPORT_COMPILE_COMMANDS ON)
if(NOT CMAKE_BUILD_TYPE)
  set(CMAKE_BUILD_TYPE RelWithDebInfo)
endif()

# A 32-bit build must not take a file with a large inode number or size for a missing one.
add_compile_definitions(_FILE_OFFSET_BITS=64)

# What most sources of the product include is read by the compiler once, where several sources are compiled at a time
# anyway: the preset `coverage` compiles each alone, and so proves that it includes what it uses.
# For all libraries that there are yet.
function(read_standard_headers_once)
  if(NOT CMAKE_UNITY_BUILD)
    return()
  endif()
  file(CONFIGURE OUTPUT standard_headers.cpp CONTENT "")
  add_library(standard_headers OBJECT "${CMAKE_CURRENT_BINARY_DIR}/standard_headers.cpp")
  target_precompile_headers(standard_headers PRIVATE <algorithm> <array> <charconv> <chrono> <filesystem> <functional>
                            <map> <memory> <mutex> <optional> <set> <sstream> <string> <string_view> <thread>
                            <unordered_map> <vector>)
  get_property(directories DIRECTORY PROPERTY SUBDIRECTORIES)
  foreach(directory IN LISTS directories)
    use_standard_headers("${directory}")
  endforeach()
endfunction()

function(use_standard_headers directory)
  get_property(targets DIRECTORY "${directory}" PROPERTY BUILDSYSTEM_TARGETS)
  foreach(target IN LISTS targets)
    get_target_property(type ${target} TYPE)
    if(type MATCHES "(STATIC|SHARED|MODULE|OBJECT)_LIBRARY")
      target_precompile_headers(${target} REUSE_FROM standard_headers)
      if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU" AND CMAKE_CXX_COMPILER_VERSION VERSION_LESS 13)
        # With headers that it has read before, it finds copies of std::string out of bounds that are not: gcc's bug
        # 105329 and its kin.
        target_compile_options(${target} PRIVATE -Wno-array-bounds -Wno-restrict -Wno-stringop-overflow
                               -Wno-stringop-overread)
      endif()
    endif()
  endforeach()
  get_property(subdirectories DIRECTORY "${directory}" PROPERTY SUBDIRECTORIES)
  foreach(subdirectory IN LISTS subdirectories)
    use_standard_headers("${subdirectory}")
  endforeach()
endfunction()

# The presets compile several sources at a time (CMAKE_UNITY_BUILD), `coverage` each alone. These cannot share a
# compilation with others of their target: they name something as another does, or a class of a header has a member of a
# type that only they know.
function(compile_alone)
  set_source_files_properties(${ARGN} PROPERTIES SKIP_UNITY_BUILD_INCLUSION ON)
endfunction()

# What a program does once, when it starts, and takes long to compile: alone, and hardly optimised, as much as the
# hardening of a package asks for.
function(compile_fast)
  compile_alone(${ARGN})
  set_source_files_properties(${ARGN} PROPERTIES SKIP_PRECOMPILE_HEADERS ON
                              COMPILE_OPTIONS "$<IF:$<CONFIG:Debug,Release>,-O0,-O1>")
endfunction()

add_compile_options(-Wall -Wextra -Wpedantic -Wshadow -Wnon-virtual-dtor -Wold-style-cast -Woverloaded-virtual
                    -Wformat=2)

find_program(CCACHE ccache)
if(CCACHE)
  set(CMAKE_CXX_COMPILER_LAUNCHER "${CCACHE}")
endif()

# Where clang compiles for 32 bits, atomics of eight bytes are calls of a library.
if(CMAKE_CXX_COMPILER_ID STREQUAL "Clang" AND CMAKE_SIZEOF_VOID_P EQUAL 4)
  link_libraries(atomic)
endif()

if(SANITIZE)
  add_compile_options(-fsanitize=${SANITIZE} -fno-omit-frame-pointer -fno-sanitize-recover=all)
  add_link_options(-fsanitize=${SANITIZE})
else()
  add_link_options(-Wl,--no-undefined)
endif()
if(COVERAGE)
  add_compile_options(--coverage -fprofile-update=atomic)
  add_link_options(--coverage)
endif()
