# The build tree has the layout of the install tree, so that `quarn` finds its libraries, plug-ins
# and shared files by the same relative paths in both.
set(QUARN_BIN_FOLDER bin)
set(QUARN_LIB_FOLDER lib)
set(QUARN_PLUGIN_FOLDER lib/quarn/plug-ins)
set(QUARN_SHARE_FOLDER share/quarn)
set(QUARN_INCLUDE_FOLDER include/quarn)

set(CMAKE_RUNTIME_OUTPUT_DIRECTORY "${PROJECT_BINARY_DIR}/${QUARN_BIN_FOLDER}")
set(CMAKE_LIBRARY_OUTPUT_DIRECTORY "${PROJECT_BINARY_DIR}/${QUARN_LIB_FOLDER}")
set(CMAKE_BUILD_RPATH_USE_ORIGIN ON)

if(NOT DEFINED CMAKE_CXX_COMPILER_LAUNCHER)
    # Looked for once: a folder that began without it would be built anew if it came later.
    if(NOT DEFINED CACHE{QUARN_CCACHE})
        find_program(QUARN_CCACHE ccache)
        mark_as_advanced(QUARN_CCACHE)
    endif()
    if(QUARN_CCACHE)
        # It keeps precompiled headers too, if it may trust their names and times.
        set(CMAKE_CXX_COMPILER_LAUNCHER
            "${CMAKE_COMMAND}" -E env CCACHE_SLOPPINESS=pch_defines,time_macros "${QUARN_CCACHE}")
    endif()
endif()
