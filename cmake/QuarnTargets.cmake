# Restricts the exported symbols of `target` to what the version script `map` names.
function(quarn_export_only target map)
    target_link_options(${target} PRIVATE "-Wl,--version-script=${map}")
    set_property(TARGET ${target} APPEND PROPERTY LINK_DEPENDS "${map}")
endfunction()

# Makes `target`, a module, a plug-in file `<name>.qnp` in `folder`.
function(quarn_plugin_file target name folder)
    set_target_properties(${target} PROPERTIES
        PREFIX "" OUTPUT_NAME "${name}" SUFFIX ".qnp"
        LIBRARY_OUTPUT_DIRECTORY "${folder}")
endfunction()

# Copies `files` to <build>/<folder> whenever they change, and installs them to <prefix>/<folder>.
function(quarn_shared_files target folder)
    set(copies)
    foreach(file IN LISTS ARGN)
        cmake_path(GET file FILENAME name)
        set(copy "${PROJECT_BINARY_DIR}/${folder}/${name}")
        add_custom_command(OUTPUT "${copy}"
            COMMAND ${CMAKE_COMMAND} -E copy "${file}" "${copy}"
            DEPENDS "${file}" VERBATIM)
        list(APPEND copies "${copy}")
    endforeach()
    add_custom_target(${target} ALL DEPENDS ${copies})
    if(QUARN_INSTALL AND ARGN)
        install(FILES ${ARGN} DESTINATION ${folder})
    endif()
endfunction()

# What most sources of the large rooms include: without parsing it in each they take three quarters of
# the time to build.
set(QUARN_COMMON_HEADERS <algorithm> <filesystem> <functional> <map> <memory> <optional> <string>
    <string_view> <vector>)

# Reads `headers` once for all sources of `target`: a whole build takes less time, while a source that
# is edited alone would wait for them. Sources go on including what they use.
function(quarn_precompile target)
    if(QUARN_WHOLE_BUILDS)
        target_precompile_headers(${target} PRIVATE ${ARGN})
        # Lets ccache see what was precompiled. Of precompiled headers g++ 12 forgets that they are the
        # system's, and warns there of the joining of short texts (its bug 105651).
        target_compile_options(${target} PRIVATE
            "$<$<CXX_COMPILER_ID:GNU>:-fpch-preprocess;-Wno-stringop-overflow;-Wno-array-bounds>")
    endif()
endfunction()

# Compiles the `sources` of `target` that lie in one folder together, up to eight at a time: a whole
# build takes less than half the time. Neighbours in a folder must not give two things of their own
# (those in anonymous namespaces) one name; those with compile options of their own stay alone.
function(quarn_join_neighbours target)
    if(NOT QUARN_WHOLE_BUILDS)
        return()
    endif()
    set_target_properties(${target} PROPERTIES UNITY_BUILD ON UNITY_BUILD_MODE GROUP)
    foreach(source IN LISTS ARGN)
        cmake_path(GET source PARENT_PATH folder)
        string(REPLACE "${CMAKE_CURRENT_SOURCE_DIR}" "" folder "${folder}")
        string(MAKE_C_IDENTIFIER "${folder}" folder)
        math(EXPR group "${joined_${folder}} + 0")
        math(EXPR joined_${folder} "${group} + 1")
        math(EXPR group "${group} / 8")
        set_source_files_properties("${source}" PROPERTIES UNITY_GROUP "${folder}_${group}")
    endforeach()
endfunction()
