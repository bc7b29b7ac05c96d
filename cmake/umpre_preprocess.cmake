# SPDX-License-Identifier: MIT
#
# umpre_preprocess(TARGET target SOURCES source... [DEFINES NAME[=text]...]
#                  [INCLUDE_DIRECTORIES directory...] [OUTPUT_EXTENSION .txt])
#
# Adds a target that preprocesses each source into a file of the same name in the current binary
# directory, with another extension (.i if none is given). A file is written only when its contents
# change; a source is read again when it changes, or any file that it includes. An error in a source
# fails the build. The property UMPRE_OUTPUTS of the target has the names of the files.
#
# Included files are looked for in the directories given, and, when they are quoted, in the current
# binary directory first. Relative names are relative to the current source directory.
function(umpre_preprocess)
    cmake_parse_arguments(PARSE_ARGV 0 arg "" "TARGET;OUTPUT_EXTENSION"
        "SOURCES;DEFINES;INCLUDE_DIRECTORIES")
    if(NOT arg_TARGET OR NOT arg_SOURCES OR arg_UNPARSED_ARGUMENTS)
        message(FATAL_ERROR "umpre_preprocess(TARGET target SOURCES source... "
            "[DEFINES definition...] [INCLUDE_DIRECTORIES directory...] "
            "[OUTPUT_EXTENSION extension])")
    endif()
    if(NOT arg_OUTPUT_EXTENSION)
        set(arg_OUTPUT_EXTENSION .i)
    endif()
    # The caller may have variables of these names.
    set(options "")
    set(outputs "")
    set(stamps "")
    foreach(definition IN LISTS arg_DEFINES)
        list(APPEND options "-D${definition}")
    endforeach()
    foreach(directory IN LISTS arg_INCLUDE_DIRECTORIES)
        get_filename_component(directory "${directory}" ABSOLUTE)
        list(APPEND options "-I${directory}")
    endforeach()
    foreach(source IN LISTS arg_SOURCES)
        get_filename_component(path "${source}" ABSOLUTE)
        get_filename_component(name "${source}" NAME_WLE)
        set(output "${CMAKE_CURRENT_BINARY_DIR}/${name}${arg_OUTPUT_EXTENSION}")
        # The stamp is new after each run, the output only when it is another one.
        add_custom_command(OUTPUT "${output}.stamp" BYPRODUCTS "${output}"
            COMMAND umpre::umpre-deps ${options} -MF "${output}.d" -MQ "${output}.stamp"
                -o "${output}.new" "${path}"
            COMMAND ${CMAKE_COMMAND} -E copy_if_different "${output}.new" "${output}"
            COMMAND ${CMAKE_COMMAND} -E touch "${output}.stamp"
            DEPENDS "${path}" umpre::umpre-deps
            DEPFILE "${output}.d"
            WORKING_DIRECTORY "${CMAKE_CURRENT_BINARY_DIR}"
            COMMENT "Preprocessing ${source}"
            VERBATIM)
        list(APPEND outputs "${output}")
        list(APPEND stamps "${output}.stamp")
    endforeach()
    add_custom_target(${arg_TARGET} ALL DEPENDS ${stamps})
    set_property(TARGET ${arg_TARGET} PROPERTY UMPRE_OUTPUTS "${outputs}")
endfunction()
