# Installs the build tree, moves the result elsewhere, builds the smallest plug-in against it, and
# runs that plug-in's command in the installed program.
#   cmake -DBUILD=<build tree> -DSOURCE=<project root> -DWORK=<scratch folder> -P InstallTree.cmake
function(run what)
    execute_process(COMMAND ${ARGN} RESULT_VARIABLE result OUTPUT_VARIABLE text ERROR_VARIABLE text)
    if(NOT result EQUAL 0)
        message(FATAL_ERROR "${what} failed (${result}):\n${text}")
    endif()
    set(text "${text}" PARENT_SCOPE)
endfunction()

file(REMOVE_RECURSE "${WORK}")
run("installing" ${CMAKE_COMMAND} --install "${BUILD}" --prefix "${WORK}/first")
file(MAKE_DIRECTORY "${WORK}/moved to")
file(RENAME "${WORK}/first" "${WORK}/moved to/quarn")
set(tree "${WORK}/moved to/quarn")

foreach(file IN ITEMS bin/quarn bin/quarn-reader lib/libQnCore.so lib/libKelmar.so lib/quarn/plug-ins/Zoetrix.qnp
        include/quarn/kelmar/kelmar.h include/quarn/sdk/qncore/qncore.h
        share/quarn/dialogs/4203.dialog.json share/quarn/dialogs/Zoetrix/6004.dialog.json
        share/quarn/viewer/viewer.html)
    if(NOT EXISTS "${tree}/${file}")
        message(FATAL_ERROR "the installed tree lacks ${file}")
    endif()
endforeach()
if(EXISTS "${BUILD}/lib/quarn/plug-ins/ZEL_VexUI.qnp")
    foreach(file IN ITEMS lib/quarn/plug-ins/ZEL_VexUI.qnp share/quarn/locale/ZEL_VexUI/de.json)
        if(NOT EXISTS "${tree}/${file}")
            message(FATAL_ERROR "the installed tree lacks ${file}")
        endif()
    endforeach()
endif()
if(EXISTS "${BUILD}/lib/libQnCocoa.so")
    foreach(file IN ITEMS lib/libQnCocoa.so lib/libZoetrixCocoa.so
            share/quarn/cocoa/QXTurnTableDialog.xib include/quarn/sdk/cocoa/QXDialogController.h)
        if(NOT EXISTS "${tree}/${file}")
            message(FATAL_ERROR "the installed tree lacks ${file}")
        endif()
    endforeach()
endif()
if(EXISTS "${tree}/include/quarn/host")
    message(FATAL_ERROR "the installed headers contain the host's own")
endif()
foreach(internal IN ITEMS KM_CaseFold.h KM_LittleEndian.h KM_SpanParameters.h)
    if(EXISTS "${tree}/include/quarn/kelmar/${internal}")
        message(FATAL_ERROR "the installed headers contain the toolkit's own ${internal}")
    endif()
endforeach()

run("configuring the example" ${CMAKE_COMMAND} -S "${SOURCE}/examples/plug-in" -B "${WORK}/hello"
    -G Ninja "-DCMAKE_PREFIX_PATH=${tree}" "-DCMAKE_CXX_COMPILER=${COMPILER}"
    "-DCMAKE_CXX_FLAGS=${FLAGS}")
run("building the example" ${CMAKE_COMMAND} --build "${WORK}/hello")

file(WRITE "${WORK}/hello.txt" "LoadPlugIn \"${WORK}/hello/Hello.qnp\"\nHello\n")
run("running the example" "${tree}/bin/quarn" run "${WORK}/hello.txt")
if(NOT text MATCHES "Hello from a plug-in")
    message(FATAL_ERROR "the example's command did not speak:\n${text}")
endif()

file(WRITE "${WORK}/triangle.obj" "o Roof\nv 0 0 0\nv 1 0 0\nv 0 1 0\nf 1 2 3\n")
run("reading a model" "${tree}/bin/quarn" info "${WORK}/triangle.obj")

file(WRITE "${WORK}/help.txt" "Help\n")
run("listing the commands" "${tree}/bin/quarn" run "${WORK}/help.txt")
if(NOT text MATCHES "SetTurntableAnimation")
    message(FATAL_ERROR "the installed program does not know the plug-in's commands:\n${text}")
endif()
