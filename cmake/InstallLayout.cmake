# Where installed files lie: the folders of GNUInstallDirs, and the one of the provider library.

# -m32 on a 64-bit Debian: CMake does not learn the architecture's folder from the compiler.
if(CMAKE_INSTALL_PREFIX STREQUAL "/usr" AND EXISTS "/etc/debian_version"
   AND CMAKE_SIZEOF_VOID_P EQUAL 4 AND CMAKE_SYSTEM_PROCESSOR MATCHES "^(x86_64|i.86)$")
  set(CMAKE_INSTALL_LIBDIR "lib/i386-linux-gnu" CACHE PATH "Object code libraries")
endif()
include(GNUInstallDirs)

# A server loads its providers from a folder of its own.
if(CIM_API STREQUAL "openpegasus")
  set(provider_dir "${CMAKE_INSTALL_LIBDIR}/Pegasus/providers")
else()
  set(provider_dir "${CMAKE_INSTALL_LIBDIR}/commonprovider")
endif()
set(COMMONPROVIDER_PROVIDER_DIR "${provider_dir}" CACHE PATH
  "Folder of the installed libCommonProvider.so; relative to the prefix unless absolute")
cmake_path(ABSOLUTE_PATH COMMONPROVIDER_PROVIDER_DIR BASE_DIRECTORY "${CMAKE_INSTALL_PREFIX}"
  OUTPUT_VARIABLE COMMONPROVIDER_PROVIDER_FULL_DIR)

# As seen from the programs' folder, so that an installation may be moved. libcimapi, which cimhost and the provider share and
# which promises its interface to nobody else, lies beside the provider.
file(RELATIVE_PATH COMMONPROVIDER_PROVIDER_FROM_BINDIR
  "${CMAKE_INSTALL_FULL_BINDIR}" "${COMMONPROVIDER_PROVIDER_FULL_DIR}")
