# For plug-in authors: quarn_add_plugin(<name> <source>...) builds `<name>.qnp`, which links the
# host's libraries, exports the entry points alone, and can be unloaded.
set(QUARN_PLUGIN_MAP "${CMAKE_CURRENT_LIST_DIR}/PlugIn.map")

function(quarn_add_plugin name)
    add_library(${name} MODULE ${ARGN})
    target_link_libraries(${name} PRIVATE Quarn::QnCore Quarn::Kelmar)
    target_compile_options(${name} PRIVATE $<$<CXX_COMPILER_ID:GNU>:-fno-gnu-unique>)
    target_link_options(${name} PRIVATE -Wl,-z,defs "-Wl,--version-script=${QUARN_PLUGIN_MAP}")
    set_target_properties(${name} PROPERTIES
        PREFIX "" SUFFIX ".qnp" LINK_DEPENDS "${QUARN_PLUGIN_MAP}"
        CXX_VISIBILITY_PRESET hidden VISIBILITY_INLINES_HIDDEN ON)
endfunction()
