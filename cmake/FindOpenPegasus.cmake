# Finds an OpenPegasus server's provider API: headers, libpegcommon and libpegprovider.
#
# OpenPegasus_ROOT is where the server is installed or was built: headers in include/ or src/,
# libraries in lib/, lib64/ or the machine's library folder. A server that was built apart from its
# sources has two roots: -DOpenPegasus_ROOT="SOURCES;HOME", as a list.
#
# OpenPegasus_PLATFORM names the platform as the server's build does (LINUX_X86_64_GNU, ...); it is
# derived from the processor, the word size and the compiler.
#
# Defines OpenPegasus_FOUND, OpenPegasus_LIBRARY_DIR, OpenPegasus_CIMSERVER (the server's program, if
# there is one) and the targets OpenPegasus::pegcommon and OpenPegasus::pegprovider.

find_path(OpenPegasus_INCLUDE_DIR Pegasus/Common/Config.h PATH_SUFFIXES include src)
# Of a release there may be libraries without the name that only developers need.
find_library(OpenPegasus_COMMON_LIBRARY NAMES pegcommon libpegcommon.so.1)
find_library(OpenPegasus_PROVIDER_LIBRARY NAMES pegprovider libpegprovider.so.1)
find_program(OpenPegasus_CIMSERVER cimserver PATH_SUFFIXES bin sbin)
mark_as_advanced(OpenPegasus_INCLUDE_DIR OpenPegasus_COMMON_LIBRARY OpenPegasus_PROVIDER_LIBRARY
  OpenPegasus_CIMSERVER)

if(CMAKE_SYSTEM_PROCESSOR MATCHES "^(x86_64|AMD64|i.86)$")
  if(CMAKE_SIZEOF_VOID_P EQUAL 8)
    set(platform LINUX_X86_64)
  else()
    set(platform LINUX_IX86)
  endif()
elseif(CMAKE_SYSTEM_PROCESSOR STREQUAL "aarch64" AND CMAKE_SIZEOF_VOID_P EQUAL 8)
  set(platform LINUX_AARCH64)
endif()
if(platform)
  if(CMAKE_CXX_COMPILER_ID MATCHES Clang AND NOT platform STREQUAL "LINUX_AARCH64")
    string(APPEND platform _CLANG)
  else()
    string(APPEND platform _GNU)
  endif()
endif()
set(OpenPegasus_PLATFORM "${platform}" CACHE STRING "Platform as the server's build names it")
unset(platform)

include(FindPackageHandleStandardArgs)
find_package_handle_standard_args(OpenPegasus
  REQUIRED_VARS OpenPegasus_COMMON_LIBRARY OpenPegasus_PROVIDER_LIBRARY OpenPegasus_INCLUDE_DIR
    OpenPegasus_PLATFORM
  REASON_FAILURE_MESSAGE "Set OpenPegasus_ROOT to where the server is installed.")

if(OpenPegasus_FOUND AND NOT TARGET OpenPegasus::pegcommon)
  get_filename_component(OpenPegasus_LIBRARY_DIR "${OpenPegasus_COMMON_LIBRARY}" DIRECTORY)
  add_library(OpenPegasus::pegcommon UNKNOWN IMPORTED)
  set_target_properties(OpenPegasus::pegcommon PROPERTIES
    IMPORTED_LOCATION "${OpenPegasus_COMMON_LIBRARY}"
    INTERFACE_INCLUDE_DIRECTORIES "${OpenPegasus_INCLUDE_DIR}"
    INTERFACE_COMPILE_DEFINITIONS "PEGASUS_PLATFORM_${OpenPegasus_PLATFORM}"
    # Interfaces that a provider must do without: a server may have been built without them.
    INTERFACE_COMPILE_OPTIONS
      "-UPEGASUS_USE_EXPERIMENTAL_INTERFACES;-UPEGASUS_USE_DEPRECATED_INTERFACES"
    # Libraries that these two need in their turn.
    INTERFACE_LINK_OPTIONS "LINKER:-rpath-link,${OpenPegasus_LIBRARY_DIR}")
  add_library(OpenPegasus::pegprovider UNKNOWN IMPORTED)
  set_target_properties(OpenPegasus::pegprovider PROPERTIES
    IMPORTED_LOCATION "${OpenPegasus_PROVIDER_LIBRARY}"
    INTERFACE_LINK_LIBRARIES OpenPegasus::pegcommon)
endif()
