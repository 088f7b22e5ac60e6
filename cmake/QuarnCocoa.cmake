# Objective-C++ and the Cocoa frameworks: those of macOS, or GNUstep's. To be included by the top
# folder, because that is where a language is switched on.
if(NOT APPLE AND NOT DEFINED CMAKE_OBJCXX_COMPILER AND NOT CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
    # GNUstep here is made for g++'s Objective-C.
    set(CMAKE_OBJCXX_COMPILER g++)
elseif(NOT DEFINED CMAKE_OBJCXX_COMPILER)
    set(CMAKE_OBJCXX_COMPILER "${CMAKE_CXX_COMPILER}")
endif()
enable_language(OBJCXX)

set(CMAKE_OBJCXX_VISIBILITY_PRESET hidden)
if(NOT DEFINED CMAKE_OBJCXX_COMPILER_LAUNCHER AND CMAKE_CXX_COMPILER_LAUNCHER)
    set(CMAKE_OBJCXX_COMPILER_LAUNCHER "${CMAKE_CXX_COMPILER_LAUNCHER}")
endif()

# What Objective-C++ sources are compiled and linked with.
add_library(quarn_cocoa INTERFACE)
# CMake knows no flag for the standard of g++'s Objective-C++.
target_compile_options(quarn_cocoa INTERFACE $<$<COMPILE_LANGUAGE:OBJCXX>:-std=c++20>)
if(APPLE)
    target_compile_options(quarn_cocoa INTERFACE
        $<$<COMPILE_LANGUAGE:OBJCXX>:-fno-objc-arc>)
    target_link_libraries(quarn_cocoa INTERFACE "-framework Cocoa")
else()
    set(hint "install libgnustep-gui-dev and gobjc++, or configure with -DQUARN_BUILD_COCOA=OFF")
    find_path(QUARN_GNUSTEP_FOLDER AppKit/AppKit.h PATH_SUFFIXES GNUstep)
    find_library(QUARN_GNUSTEP_GUI gnustep-gui)
    find_library(QUARN_GNUSTEP_BASE gnustep-base)
    if(NOT QUARN_GNUSTEP_FOLDER OR NOT QUARN_GNUSTEP_GUI OR NOT QUARN_GNUSTEP_BASE)
        message(FATAL_ERROR "GNUstep was not found: ${hint}")
    endif()
    target_include_directories(quarn_cocoa SYSTEM INTERFACE "${QUARN_GNUSTEP_FOLDER}")
    target_compile_definitions(quarn_cocoa INTERFACE
        GNUSTEP GNUSTEP_BASE_LIBRARY=1 GNU_GUI_LIBRARY=1 GNU_RUNTIME=1
        _NATIVE_OBJC_EXCEPTIONS)
    target_compile_options(quarn_cocoa INTERFACE
        "$<$<COMPILE_LANGUAGE:OBJCXX>:-fobjc-exceptions;-fconstant-string-class=NSConstantString>")
    # g++ warns of the setters that it makes itself for properties.
    target_compile_options(quarn_cocoa INTERFACE
        $<$<COMPILE_LANGUAGE:OBJCXX>:-Wno-unused-parameter>)
    target_link_libraries(quarn_cocoa INTERFACE
        "${QUARN_GNUSTEP_GUI}" "${QUARN_GNUSTEP_BASE}" objc)
endif()
