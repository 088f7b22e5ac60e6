include(CMakePackageConfigHelpers)

set(package_folder ${QUARN_LIB_FOLDER}/cmake/Quarn)
foreach(target IN ITEMS Kelmar QnCore)
    if(TARGET ${target})
        install(TARGETS ${target} EXPORT QuarnTargets LIBRARY DESTINATION ${QUARN_LIB_FOLDER})
    endif()
endforeach()
if(TARGET Zoetrix)
    install(TARGETS Zoetrix LIBRARY DESTINATION ${QUARN_PLUGIN_FOLDER})
endif()
if(TARGET quarn)
    install(TARGETS quarn RUNTIME DESTINATION ${QUARN_BIN_FOLDER})
endif()

foreach(folder IN ITEMS kelmar sdk)
    if(IS_DIRECTORY "${PROJECT_SOURCE_DIR}/${folder}")
        install(DIRECTORY "${PROJECT_SOURCE_DIR}/${folder}" DESTINATION ${QUARN_INCLUDE_FOLDER}
            FILES_MATCHING PATTERN "*.h")
    endif()
endforeach()

if(TARGET QnCore)
    install(EXPORT QuarnTargets NAMESPACE Quarn:: DESTINATION ${package_folder})
    configure_package_config_file("${PROJECT_SOURCE_DIR}/cmake/QuarnConfig.cmake.in"
        "${PROJECT_BINARY_DIR}/QuarnConfig.cmake" INSTALL_DESTINATION ${package_folder})
    write_basic_package_version_file("${PROJECT_BINARY_DIR}/QuarnConfigVersion.cmake"
        COMPATIBILITY ExactVersion)
    install(FILES "${PROJECT_BINARY_DIR}/QuarnConfig.cmake"
        "${PROJECT_BINARY_DIR}/QuarnConfigVersion.cmake"
        "${PROJECT_SOURCE_DIR}/cmake/PlugIn.map"
        "${PROJECT_SOURCE_DIR}/cmake/QuarnPlugIn.cmake"
        DESTINATION ${package_folder})
endif()
