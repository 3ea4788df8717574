# The one version of libTavo_Windows, from the top-level project's VERSION:
# written into the generated header Tavo_WiVersion.h (installed with the
# library's headers) and into a version resource of each DLL.

set(TAVO_GENERATED_DIR ${PROJECT_BINARY_DIR}/generated)
set(TAVO_VERSION_HEADER ${TAVO_GENERATED_DIR}/include/Tavo_WiVersion.h)
configure_file(${CMAKE_CURRENT_LIST_DIR}/templates/Tavo_WiVersion.h.in ${TAVO_VERSION_HEADER} @ONLY)

# tavo_version_resource(<target> DESCRIPTION <text>)
# Compiles a VERSIONINFO resource into the DLL <target>: file and product
# version, the description, and the DLL's own file name.
function(tavo_version_resource target)
  cmake_parse_arguments(ARG "" "DESCRIPTION" "" ${ARGN})
  # The names come from the target, so they follow any change of its output
  # name: configure_file fills in the version and the description, and
  # file(GENERATE) then resolves the generator expressions.
  set(TAVO_VERSION_DESCRIPTION ${ARG_DESCRIPTION})
  set(TAVO_VERSION_FILE_NAME "$<TARGET_FILE_NAME:${target}>")
  set(TAVO_VERSION_INTERNAL_NAME "$<TARGET_FILE_BASE_NAME:${target}>")
  set(configured ${TAVO_GENERATED_DIR}/versioninfo/${target}.rc.in)
  set(rc ${TAVO_GENERATED_DIR}/versioninfo/${target}.rc)
  configure_file(${CMAKE_CURRENT_FUNCTION_LIST_DIR}/templates/VersionInfo.rc.in ${configured} @ONLY)
  file(GENERATE OUTPUT ${rc} INPUT ${configured})
  target_sources(${target} PRIVATE ${rc})
endfunction()
