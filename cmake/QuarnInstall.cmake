include(CMakePackageConfigHelpers)

set(package_folder ${QUARN_LIB_FOLDER}/cmake/Quarn)
install(TARGETS Kelmar QnCore EXPORT QuarnTargets LIBRARY DESTINATION ${QUARN_LIB_FOLDER})
if(QUARN_BUILD_COCOA)
    install(TARGETS QnCocoa EXPORT QuarnTargets LIBRARY DESTINATION ${QUARN_LIB_FOLDER})
    install(TARGETS ZoetrixCocoa LIBRARY DESTINATION ${QUARN_LIB_FOLDER})
else()
    set(without_cocoa PATTERN "cocoa" EXCLUDE)
endif()
install(TARGETS Zoetrix LIBRARY DESTINATION ${QUARN_PLUGIN_FOLDER})
install(TARGETS quarn RUNTIME DESTINATION ${QUARN_BIN_FOLDER})
install(DIRECTORY "${PROJECT_SOURCE_DIR}/kelmar" "${PROJECT_SOURCE_DIR}/sdk"
    DESTINATION ${QUARN_INCLUDE_FOLDER} FILES_MATCHING PATTERN "*.h"
    ${without_cocoa}
    # What the toolkit's own sources share is not for plug-in authors.
    PATTERN "KM_CaseFold.h" EXCLUDE
    PATTERN "KM_LittleEndian.h" EXCLUDE
    PATTERN "KM_SpanParameters.h" EXCLUDE)

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
