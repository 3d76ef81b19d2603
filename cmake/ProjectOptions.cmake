# Compiler settings shared by every target of the project (link to project_options).

option(COMMONPROVIDER_WERROR "Treat compiler warnings as errors" OFF)
option(COMMONPROVIDER_FUZZERS "Build the fuzzers (needs clang)" OFF)
option(COMMONPROVIDER_BENCHMARKS "Build the benchmarks (needs Google Benchmark and expat)" OFF)
# CIM-XML over HTTP uses Debian's expat and libmicrohttpd, which are there for one word size only.
if(CMAKE_SIZEOF_VOID_P EQUAL 4)
  set(server_default OFF)
else()
  set(server_default ON)
endif()
option(COMMONPROVIDER_SERVER "Build the CIM server (needs expat and libmicrohttpd)" ${server_default})
set(COMMONPROVIDER_SANITIZE "" CACHE STRING "Value for -fsanitize=, for example address,undefined")

set(CMAKE_CXX_STANDARD 17)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_C_STANDARD 99)
set(CMAKE_POSITION_INDEPENDENT_CODE ON)
set(CMAKE_CXX_VISIBILITY_PRESET hidden)
set(CMAKE_VISIBILITY_INLINES_HIDDEN ON)
set(CMAKE_EXPORT_COMPILE_COMMANDS ON)
if(NOT CMAKE_BUILD_TYPE)
  set(CMAKE_BUILD_TYPE Release)
endif()

# Everything that is loaded or run lies in two folders, so that programs find their libraries
# without installation.
set(CMAKE_LIBRARY_OUTPUT_DIRECTORY "${CMAKE_BINARY_DIR}/lib")
set(CMAKE_RUNTIME_OUTPUT_DIRECTORY "${CMAKE_BINARY_DIR}/bin")

find_package(Threads REQUIRED)

add_library(project_options INTERFACE)
target_include_directories(project_options INTERFACE "${PROJECT_SOURCE_DIR}")
target_compile_options(project_options INTERFACE
  -Wall -Wextra -Wpedantic -Wshadow -Wconversion
  $<$<BOOL:${COMMONPROVIDER_WERROR}>:-Werror>
  # A unique symbol would pin the provider library in a server's memory after dlclose.
  $<$<COMPILE_LANG_AND_ID:CXX,GNU>:-fno-gnu-unique>)
target_link_libraries(project_options INTERFACE Threads::Threads ${CMAKE_DL_LIBS})

if(COMMONPROVIDER_SANITIZE)
  add_compile_options(-fsanitize=${COMMONPROVIDER_SANITIZE} -fno-omit-frame-pointer
    -fno-sanitize-recover=all)
  add_link_options(-fsanitize=${COMMONPROVIDER_SANITIZE})
endif()

if(COMMONPROVIDER_FUZZERS)
  add_compile_options(-fsanitize=fuzzer-no-link)
endif()
