# SPDX-License-Identifier: MIT
# What `cpack` makes of the installation: a Debian package for each component.
set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_CONTACT "The umpre developers <developers@umpre.example>")
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
set(CPACK_COMPONENTS_ALL programs library)
set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
# The first line of both descriptions.
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "preprocessor for C-like source text")

set(CPACK_DEBIAN_PROGRAMS_PACKAGE_NAME umpre)
set(CPACK_DEBIAN_PROGRAMS_PACKAGE_SECTION devel)
set(CPACK_DEBIAN_PROGRAMS_DESCRIPTION
"umpre reads C-like source text, carries out its directives, expands its macros
and writes the result, line for line, with markers that say which file and
line each part comes from. It knows tokens only, so text that is not C passes
as well: shaders, linker scripts, interface definitions, assembler.

umpre-deps writes which files that reads, as a rule for make.
umpre-lines turns the markers into those of GNU tools, takes them out, or
prints them as a map.")

set(CPACK_DEBIAN_LIBRARY_PACKAGE_NAME libumpre-dev)
set(CPACK_DEBIAN_LIBRARY_PACKAGE_SECTION libdevel)
set(CPACK_DEBIAN_LIBRARY_PACKAGE_DEPENDS "umpre (= ${PROJECT_VERSION})")
set(CPACK_DEBIAN_LIBRARY_DESCRIPTION
"The engine of umpre, to be used from within a program: sources come from files
or memory, the result and the problems found go to functions of the caller.

This package has the static library and its headers.")

set(CPACK_PRE_BUILD_SCRIPTS ${PROJECT_SOURCE_DIR}/cmake/DebianFiles.cmake)
include(CPack)
