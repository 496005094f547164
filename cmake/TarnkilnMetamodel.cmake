# Makes the C++ classes of a metamodel part of a target.
#
#     tarnkiln_add_metamodel(TARGET library_model DESCRIPTION library.json [PRECOMPILED])
#
# docs/metamodel-description.md tells how the description is written. The sources are generated in
# the build tree, from where the target compiles them; whoever links to the target includes them by
# the folder that the description names. They are made anew when the description, one that it
# imports, or the generator changes. A description that contradicts itself stops the build; the
# message names the place. Needs Python 3.11 with Jinja2, when the project is built and not later.
#
# Operations and derived properties are written by hand and added to the same target.
#
# PRECOMPILED lets all sources of the target begin with a precompiled header that holds what the
# generated ones include of the library, which halves the time that they take. It pays from about
# five classes upward.

include_guard(GLOBAL)

function(tarnkiln_add_metamodel)
    cmake_parse_arguments(PARSE_ARGV 0 arg "PRECOMPILED" "TARGET;DESCRIPTION" "")
    if(NOT arg_TARGET OR NOT arg_DESCRIPTION OR arg_UNPARSED_ARGUMENTS)
        message(FATAL_ERROR
            "use it like tarnkiln_add_metamodel(TARGET target DESCRIPTION file.json)")
    endif()
    get_property(metagen GLOBAL PROPERTY TARNKILN_METAGEN)
    find_package(Python3 3.11 REQUIRED COMPONENTS Interpreter)

    get_filename_component(description ${arg_DESCRIPTION} ABSOLUTE)
    set(root ${CMAKE_CURRENT_BINARY_DIR}/metamodel/${arg_TARGET})
    set(generate ${Python3_EXECUTABLE} -B ${metagen} ${description} ${root} --root)

    # What is read, so that a change leads back here; a broken description is read as well.
    set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS ${description})
    tarnkiln_ask_metagen(inputs ${generate} --inputs)
    set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS ${inputs})
    tarnkiln_ask_metagen(names ${generate} --list)
    list(TRANSFORM names PREPEND ${root}/ OUTPUT_VARIABLE files)

    add_custom_command(
        OUTPUT ${files}
        COMMAND ${generate}
        DEPENDS ${inputs}
        COMMENT "Generating the classes of ${arg_DESCRIPTION}"
        VERBATIM)
    target_sources(${arg_TARGET} PRIVATE ${files})
    target_include_directories(${arg_TARGET} PUBLIC $<BUILD_INTERFACE:${root}>)
    target_link_libraries(${arg_TARGET} PUBLIC tarnkiln::tarnkiln)
    target_compile_features(${arg_TARGET} PUBLIC cxx_std_20)
    if(arg_PRECOMPILED)
        target_precompile_headers(${arg_TARGET} PRIVATE <tarnkiln/support/GeneratedSource.h>)
    endif()
endfunction()

# Sets `variable` to the lines that the generator prints; stops with its message if it fails.
function(tarnkiln_ask_metagen variable)
    execute_process(COMMAND ${ARGN}
        OUTPUT_VARIABLE lines ERROR_VARIABLE reason RESULT_VARIABLE failed
        OUTPUT_STRIP_TRAILING_WHITESPACE)
    if(failed)
        # Lines that are indented are printed as they are.
        string(REPLACE "\n" "\n  " reason "\n${reason}")
        message(FATAL_ERROR "The metamodel can't be generated:${reason}")
    endif()
    string(REPLACE "\n" ";" lines "${lines}")
    set(${variable} ${lines} PARENT_SCOPE)
endfunction()
