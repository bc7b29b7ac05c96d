# SPDX-License-Identifier: MIT
# What `cmake --install` puts where: the programs (component programs), and what is needed to build
# with the library (component library).
include(CMakePackageConfigHelpers)

# Not in the folder for libraries: that may be one of an architecture, which a project without a language
# does not search.
set(package_dir ${CMAKE_INSTALL_DATADIR}/cmake/umpre)

install(TARGETS umpre umpre-deps umpre-lines EXPORT umpreProgramTargets RUNTIME COMPONENT programs)
install(FILES docs/umpre.1 docs/umpre-deps.1 docs/umpre-lines.1
    DESTINATION ${CMAKE_INSTALL_MANDIR}/man1 COMPONENT programs)
install(FILES README.md CHANGELOG.md CONTRIBUTING.md SECURITY.md LICENSE TYPE DOC COMPONENT programs)
install(DIRECTORY docs TYPE DOC COMPONENT programs FILES_MATCHING PATTERN *.md PATTERN *.svg)
install(FILES completions/umpre.bash RENAME umpre
    DESTINATION ${CMAKE_INSTALL_DATADIR}/bash-completion/completions COMPONENT programs)
install(FILES completions/umpre.bash RENAME umpre-deps
    DESTINATION ${CMAKE_INSTALL_DATADIR}/bash-completion/completions COMPONENT programs)
install(FILES completions/umpre.bash RENAME umpre-lines
    DESTINATION ${CMAKE_INSTALL_DATADIR}/bash-completion/completions COMPONENT programs)
# Where zsh looks: packages of the system have a folder of their own.
set(zsh_functions site-functions)
if(CMAKE_INSTALL_PREFIX STREQUAL "/usr")
    set(zsh_functions vendor-completions)
endif()
install(FILES completions/_umpre
    DESTINATION ${CMAKE_INSTALL_DATADIR}/zsh/${zsh_functions} COMPONENT programs)
install(FILES completions/umpre.fish completions/umpre-deps.fish completions/umpre-lines.fish
    DESTINATION ${CMAKE_INSTALL_DATADIR}/fish/vendor_completions.d COMPONENT programs)

configure_package_config_file(cmake/umpreConfig.cmake.in umpreConfig.cmake
    INSTALL_DESTINATION ${package_dir})
write_basic_package_version_file(umpreConfigVersion.cmake COMPATIBILITY SameMajorVersion)
install(FILES cmake/umpre_preprocess.cmake ${PROJECT_BINARY_DIR}/umpreConfig.cmake
    ${PROJECT_BINARY_DIR}/umpreConfigVersion.cmake
    DESTINATION ${package_dir} COMPONENT programs)
install(EXPORT umpreProgramTargets NAMESPACE umpre:: DESTINATION ${package_dir} COMPONENT programs)

install(TARGETS umpre_lib EXPORT umpreLibraryTargets
    LIBRARY COMPONENT library
    ARCHIVE COMPONENT library
    FILE_SET HEADERS COMPONENT library)
# Objects for optimisation by the linker are for one version of one compiler, and linking with them takes
# seconds.
if(CMAKE_INTERPROCEDURAL_OPTIMIZATION AND CMAKE_CXX_COMPILER_ID STREQUAL "GNU" AND NOT BUILD_SHARED_LIBS)
    install(CODE "
        cmake_path(APPEND CMAKE_INSTALL_PREFIX ${CMAKE_INSTALL_LIBDIR} $<TARGET_FILE_NAME:umpre_lib>
            OUTPUT_VARIABLE archive)
        execute_process(COMMAND ${CMAKE_OBJCOPY} --enable-deterministic-archives
            --remove-section=.gnu.lto_* \"\$ENV{DESTDIR}\${archive}\" COMMAND_ERROR_IS_FATAL ANY)"
        COMPONENT library)
endif()
install(EXPORT umpreLibraryTargets NAMESPACE umpre:: DESTINATION ${package_dir} COMPONENT library)

# Beside the folder that it is in, so that the installation can be moved.
file(RELATIVE_PATH pc_to_prefix ${CMAKE_INSTALL_FULL_LIBDIR}/pkgconfig ${CMAKE_INSTALL_PREFIX})
string(REGEX REPLACE "/$" "" pc_to_prefix ${pc_to_prefix})
cmake_path(APPEND pc_libdir "\${prefix}" ${CMAKE_INSTALL_LIBDIR})
cmake_path(APPEND pc_includedir "\${prefix}" ${CMAKE_INSTALL_INCLUDEDIR})
configure_file(cmake/umpre.pc.in umpre.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/umpre.pc
    DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig COMPONENT library)
