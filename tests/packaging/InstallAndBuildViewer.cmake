# Installs the built library into a fresh prefix and builds the viewer
# example against it, as an application developer would: the example's own
# CMakeLists.txt finds the package and nothing else of this tree.
#
#   cmake -DLIBRARY_BUILD=<build dir> -DEXAMPLE=<examples/viewer> -DWORK=<scratch dir>
#         -DTOOLCHAIN=<toolchain file> [-DBUILD_TYPE=<build type>] -P InstallAndBuildViewer.cmake
foreach(name LIBRARY_BUILD EXAMPLE WORK TOOLCHAIN)
  if(NOT DEFINED ${name})
    message(FATAL_ERROR "${name} is not set")
  endif()
endforeach()

set(prefix ${WORK}/prefix)
set(build ${WORK}/build)
file(REMOVE_RECURSE ${WORK})

function(run step)
  message(STATUS "${step}")
  execute_process(COMMAND ${ARGN} RESULT_VARIABLE status)
  if(NOT status EQUAL 0)
    message(FATAL_ERROR "${step} failed (${status})")
  endif()
endfunction()

run("installing into ${prefix}"
  ${CMAKE_COMMAND} --install ${LIBRARY_BUILD} --prefix ${prefix})
# The toolchain confines package searches to the target's root, so the
# package folder is named directly. Warnings in the example are errors.
run("configuring the viewer"
  ${CMAKE_COMMAND} -S ${EXAMPLE} -B ${build} -G "Unix Makefiles"
    -DCMAKE_TOOLCHAIN_FILE=${TOOLCHAIN}
    -DCMAKE_BUILD_TYPE=${BUILD_TYPE}
    -DlibTavo_Windows_DIR=${prefix}/lib/cmake/libTavo_Windows
    "-DCMAKE_CXX_FLAGS=-Wall -Wextra"
    -DCMAKE_COMPILE_WARNING_AS_ERROR=ON)
run("building the viewer" ${CMAKE_COMMAND} --build ${build} --parallel 2)
