# SPDX-License-Identifier: MIT
#
# umpre_harden(target...)
#
# What is compiled in for the case that a fault is left: return addresses, the stack's growth, the
# targets of jumps and calls of the C library are guarded, and what the dynamic linker fills in is
# read-only once a program runs. docs/performance.md says what that costs.
include(CheckCXXCompilerFlag)

set(umpre_guards)
foreach(flag -fstack-protector -fstack-clash-protection -fcf-protection)
    string(MAKE_C_IDENTIFIER HAS${flag} has)
    check_cxx_compiler_flag(${flag} ${has})
    if(${has})
        list(APPEND umpre_guards ${flag})
    endif()
endforeach()

function(umpre_harden)
    # The bounds of the standard library's containers cost little where few tokens come by, and guards
    # in every function that takes an address cost nothing where there are none.
    set(outside umpre_command umpre_api umpre_lines umpre_deps umpre umpre-lines umpre-deps)
    set(bounded umpre_directives umpre_driver ${outside})
    foreach(target IN LISTS ARGN)
        target_compile_options(${target} PRIVATE
            ${umpre_guards} -Werror=format-security -U_FORTIFY_SOURCE -D_FORTIFY_SOURCE=2)
        if(target IN_LIST bounded)
            target_compile_definitions(${target} PRIVATE _GLIBCXX_ASSERTIONS)
        endif()
        if(target IN_LIST outside)
            target_compile_options(${target} PRIVATE -fstack-protector-strong)
        endif()
        get_target_property(type ${target} TYPE)
        if(type STREQUAL EXECUTABLE)
            target_link_options(${target} PRIVATE -pie LINKER:-z,relro,-z,now)
        elseif(type STREQUAL SHARED_LIBRARY)
            target_link_options(${target} PRIVATE LINKER:-z,relro,-z,now)
        endif()
    endforeach()
endfunction()
