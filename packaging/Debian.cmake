# The Debian packages: `cpack -G DEB` in a build folder whose prefix is /usr (scripts/package).

set(CPACK_PACKAGE_CONTACT "CommonProvider developers <commonprovider@example.org>" CACHE STRING
  "Maintainer of the packages")
set(CPACK_DEBIAN_PACKAGE_RELEASE 1)

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME commonprovider)
set(CPACK_PACKAGE_VERSION "${PROJECT_VERSION}")
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "")  # Each package has its own.
set(CPACK_DEBIAN_PACKAGE_SOURCE commonprovider)
set(CPACK_PACKAGING_INSTALL_PREFIX "${CMAKE_INSTALL_PREFIX}")
set(CPACK_STRIP_FILES ON)
set(CPACK_INSTALL_DEFAULT_DIRECTORY_PERMISSIONS
  OWNER_READ OWNER_WRITE OWNER_EXECUTE GROUP_READ GROUP_EXECUTE WORLD_READ WORLD_EXECUTE)
set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_COMPONENTS_GROUPING ONE_PER_GROUP)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_COMPRESSION_TYPE xz)
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS
  "${CMAKE_LIBRARY_OUTPUT_DIRECTORY}" ${OpenPegasus_LIBRARY_DIR})
set(CPACK_DEBIAN_PACKAGE_PRIORITY optional)
if(CMAKE_SIZEOF_VOID_P EQUAL 4 AND CMAKE_SYSTEM_PROCESSOR MATCHES "^(x86_64|i.86)$")
  set(CPACK_DEBIAN_PACKAGE_ARCHITECTURE i386)
  if(CMAKE_SYSTEM_PROCESSOR STREQUAL "x86_64")
    # Read by cpack, whose search for dpkg-shlibdeps it answers.
    file(CONFIGURE OUTPUT CPackI386.cmake @ONLY CONTENT
      "set(SHLIBDEPS_EXECUTABLE \"@CMAKE_CURRENT_SOURCE_DIR@/shlibdeps-i386\" CACHE FILEPATH \"\")\n")
    set(CPACK_PROJECT_CONFIG_FILE "${CMAKE_CURRENT_BINARY_DIR}/CPackI386.cmake")
  endif()
endif()

# debian_package(COMPONENT PACKAGE SECTION DESCRIPTION [DEPENDS ...] [RECOMMENDS ...]): control data in
# the caller's scope; the first line of DESCRIPTION is the synopsis.
macro(debian_package component package section description)
  cmake_parse_arguments(ARG "" "DEPENDS;RECOMMENDS" "" ${ARGN})
  string(TOUPPER "${component}" upper)
  set(CPACK_DEBIAN_${upper}_PACKAGE_NAME ${package})
  set(CPACK_DEBIAN_${upper}_PACKAGE_SECTION ${section})
  set(CPACK_DEBIAN_${upper}_DESCRIPTION "${description}")
  set(CPACK_DEBIAN_${upper}_PACKAGE_DEPENDS "${ARG_DEPENDS}")
  set(CPACK_DEBIAN_${upper}_PACKAGE_RECOMMENDS "${ARG_RECOMMENDS}")
  install(FILES debian/copyright
    DESTINATION "${CMAKE_INSTALL_DATADIR}/doc/${package}" COMPONENT ${component})
  installed_gzip("${CMAKE_CURRENT_BINARY_DIR}/changelog" changelog.Debian
    "${CMAKE_INSTALL_DATADIR}/doc/${package}" ${component})
endmacro()

function(debian_packages)
  configure_file(debian/changelog.in changelog @ONLY)
  set(CPACK_COMPONENTS_ALL ${ARGN})
  # The two builds of the provider may be installed side by side.
  if(CIM_API STREQUAL "openpegasus")
    set(provider_package commonprovider-openpegasus)
    set(provider_server "OpenPegasus")
  else()
    set(provider_package commonprovider)
    set(provider_server "cimhost, the embedded CIM host")
  endif()
  debian_package(provider ${provider_package} admin "generic, data-driven CIM provider
A shared library through which a CIM server serves instances, associations
and method calls of classes that definition files describe. A definition says
which functions of a plain C library, the plug-in, give the instances and the
values of their properties.
.
This package holds the provider library for ${provider_server}.")
  if(TARGET cimhost_serve)
    set(cimhost_answers "on the command line and over HTTP (CIM-XML)")
  else()
    set(cimhost_answers "on the command line")
  endif()
  debian_package(cimhost cimhost admin "embedded CIM host for CommonProvider
A program that serves the classes of a home directory where no CIM server is
installed: it loads the provider library as a server does, reads class
declarations (MOF), and answers requests
${cimhost_answers}.
It checks definition files, too."
    DEPENDS "commonprovider (= ${CPACK_PACKAGE_VERSION}-${CPACK_DEBIAN_PACKAGE_RELEASE})"
    RECOMMENDS "bash-completion")
  debian_package(dev commonprovider-dev libdevel "header and examples for plug-ins of CommonProvider
A plug-in is a plain C library whose functions give the instances and the
properties of CIM classes.
.
This package holds the C header that checks the functions' types and reads and
writes their buffers, two examples with definition files and class
declarations, and the manuals of plug-ins, definition files and cimhost."
    RECOMMENDS "cimhost, gcc | c-compiler, make, pkg-config")
  # Nothing in it depends on the machine.
  set(CPACK_DEBIAN_DEV_PACKAGE_ARCHITECTURE all)
  set(CPACK_DEBIAN_DEV_PACKAGE_SHLIBDEPS OFF)
  include(CPack)
endfunction()
