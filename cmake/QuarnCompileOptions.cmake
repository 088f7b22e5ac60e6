# Flags for our own targets alone; they travel by linking this target and never by global variables.
add_library(quarn_compile_options INTERFACE)
target_compile_features(quarn_compile_options INTERFACE cxx_std_20)
target_compile_options(quarn_compile_options INTERFACE -Wall -Wextra -Wpedantic
    # `id` is a type of Objective-C and an ordinary name in the headers it shares with C++.
    $<$<COMPILE_LANGUAGE:CXX>:-Wshadow>)
# g++ 12 takes the joining of short texts for overlapping copies (its bug 105651).
target_compile_options(quarn_compile_options INTERFACE
    $<$<AND:$<CXX_COMPILER_ID:GNU>,$<VERSION_LESS:$<CXX_COMPILER_VERSION>,13>>:-Wno-restrict>)

if(QUARN_SANITIZERS)
    target_compile_options(quarn_compile_options INTERFACE
        -fsanitize=${QUARN_SANITIZERS} -fno-sanitize-recover=all -fno-omit-frame-pointer)
    target_link_options(quarn_compile_options INTERFACE -fsanitize=${QUARN_SANITIZERS})
    # The checks that are built in hide from g++ what its standard library has set: it warns there.
    target_compile_options(quarn_compile_options INTERFACE
        $<$<CXX_COMPILER_ID:GNU>:-Wno-maybe-uninitialized>)
endif()
if(QUARN_FUZZ)
    target_compile_options(quarn_compile_options INTERFACE -fsanitize=fuzzer-no-link)
endif()

# Geometry must come out the same on every machine, so no multiply and add is fused.
add_library(quarn_exact_arithmetic INTERFACE)
target_compile_options(quarn_exact_arithmetic INTERFACE -ffp-contract=off)

# Without unique symbols dlclose really unloads a plug-in and destroys its objects.
add_library(quarn_unloadable INTERFACE)
target_compile_options(quarn_unloadable INTERFACE $<$<CXX_COMPILER_ID:GNU>:-fno-gnu-unique>)

# The sanitizer runtimes of clang come with the executable, so a library there has open symbols.
add_library(quarn_no_open_symbols INTERFACE)
if(NOT (CMAKE_CXX_COMPILER_ID MATCHES "Clang" AND (QUARN_SANITIZERS OR QUARN_FUZZ)))
    target_link_options(quarn_no_open_symbols INTERFACE -Wl,-z,defs)
endif()
