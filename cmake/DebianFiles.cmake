# SPDX-License-Identifier: MIT
# Run by cpack between installing into folders and packing these. Gives each package what Debian wants:
# its copyright, its changelog, compressed man pages, programs without what is not needed to run them.
#
# Everything written here depends on the sources and on SOURCE_DATE_EPOCH alone.

set(source ${CMAKE_CURRENT_LIST_DIR}/..)
string(TIMESTAMP date "%a, %d %b %Y %H:%M:%S +0000" UTC)

# debian_run(WORD...): runs a command that must succeed.
function(debian_run)
    execute_process(COMMAND ${ARGN} COMMAND_ERROR_IS_FATAL ANY)
endfunction()

function(debian_documents documents)
    file(READ ${source}/LICENSE license)
    string(REGEX REPLACE "^MIT License\n\nCopyright[^\n]*\n\n" "" license "${license}")
    string(STRIP "${license}" license)
    string(REPLACE "\n\n" "\n.\n" license "${license}")
    string(REPLACE "\n" "\n " license "${license}")
    file(WRITE ${documents}/copyright
        "Format: https://www.debian.org/doc/packaging-manuals/copyright-format/1.0/\n"
        "Upstream-Name: umpre\n\n"
        "Files: *\nCopyright: 2026 The umpre developers\nLicense: Expat\n ${license}\n")
    file(WRITE ${documents}/changelog
        "umpre (${CPACK_PACKAGE_VERSION}) unstable; urgency=medium\n\n"
        "  * Release ${CPACK_PACKAGE_VERSION}.\n\n"
        " -- ${CPACK_PACKAGE_CONTACT}  ${date}\n")
    debian_run(gzip -9n ${documents}/changelog)
endfunction()

set(umpre programs)
set(libumpre-dev library)
foreach(name umpre libumpre-dev)
    set(root ${CPACK_TEMPORARY_DIRECTORY}/${${name}}/usr)
    # The copyright file says what LICENSE says.
    file(REMOVE_RECURSE ${root}/share/doc/umpre/LICENSE)
    debian_documents(${root}/share/doc/${name})
    file(GLOB pages ${root}/share/man/man1/*.1)
    if(pages)
        debian_run(gzip -9n ${pages})
    endif()
    file(GLOB programs ${root}/bin/*)
    if(programs)
        debian_run(strip --remove-section=.comment --remove-section=.note ${programs})
    endif()
    file(GLOB archives ${root}/lib/*/*.a)
    if(archives)
        debian_run(strip --strip-debug --enable-deterministic-archives --remove-section=.comment
            --remove-section=.note ${archives})
    endif()
endforeach()
