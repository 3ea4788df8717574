# What application developers get: the three DLLs with their version
# resources, and `cmake --install` producing
#
#   bin/                          afx.dll, libTavo_Core.dll, libTavo_Windows.dll
#   lib/                          their import libraries
#   include/afx/                  the framework headers (<afxwin.h> ...)
#   include/Tavo_Core/            the graphics core and support library headers
#   include/Tavo_Windows/         the library's headers and Tavo_WiVersion.h
#   lib/cmake/libTavo_Windows/    the CMake package
#
# so that `find_package(libTavo_Windows)` and linking Tavo::Windows are enough:
# Tavo::Windows brings Tavo::Core and Tavo::afx with their include folders and
# Win32 libraries. The library's string table and pan cursor are compiled into
# libTavo_Windows.dll, and the DLLs link the compiler's run-time statically,
# so the three DLLs are all a program needs beside it.
include(GNUInstallDirs)
include(CMakePackageConfigHelpers)

tavo_version_resource(afx DESCRIPTION "Application framework layer (MFC 8.0 subset) of libTavo_Windows")
tavo_version_resource(Tavo_Core DESCRIPTION "Tavo graphics core and support libraries")
tavo_version_resource(Tavo_Windows DESCRIPTION "Tavo Windows presentation layer: GDI rendering, scroll and drawing windows")

target_include_directories(Tavo_Windows PUBLIC $<BUILD_INTERFACE:${TAVO_GENERATED_DIR}/include>)
# The public headers use C++17; users compile with it at least.
foreach(target afx Tavo_Core Tavo_Windows)
  target_compile_features(${target} PUBLIC cxx_std_17)
endforeach()

# Imported names: Tavo::afx, Tavo::Core, Tavo::Windows, after the DLLs.
set_target_properties(Tavo_Core PROPERTIES EXPORT_NAME Core)
set_target_properties(Tavo_Windows PROPERTIES EXPORT_NAME Windows)

# tavo_install_layer(<target> <header folder>): the DLL, its import library
# and its public headers, which go to a folder named after the target.
function(tavo_install_layer target headers)
  set(include_dir ${CMAKE_INSTALL_INCLUDEDIR}/${target})
  install(TARGETS ${target} EXPORT ${PROJECT_NAME}Targets
    RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR}
    ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR}
    INCLUDES DESTINATION ${include_dir})
  install(DIRECTORY ${PROJECT_SOURCE_DIR}/${headers}/ DESTINATION ${include_dir} FILES_MATCHING PATTERN "*.h")
endfunction()

tavo_install_layer(afx framework/include)
tavo_install_layer(Tavo_Core core/include)
tavo_install_layer(Tavo_Windows include)
install(FILES ${TAVO_VERSION_HEADER} DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/Tavo_Windows)

set(TAVO_PACKAGE_DIR ${CMAKE_INSTALL_LIBDIR}/cmake/${PROJECT_NAME})
install(EXPORT ${PROJECT_NAME}Targets NAMESPACE Tavo:: DESTINATION ${TAVO_PACKAGE_DIR})
configure_package_config_file(${CMAKE_CURRENT_LIST_DIR}/templates/PackageConfig.cmake.in
  ${TAVO_GENERATED_DIR}/package/${PROJECT_NAME}Config.cmake
  INSTALL_DESTINATION ${TAVO_PACKAGE_DIR})
# Until 1.0 a minor release may change the interface: only the same minor
# version is compatible. The file also turns away 32-bit users.
write_basic_package_version_file(${TAVO_GENERATED_DIR}/package/${PROJECT_NAME}ConfigVersion.cmake
  COMPATIBILITY SameMinorVersion)
install(FILES
  ${TAVO_GENERATED_DIR}/package/${PROJECT_NAME}Config.cmake
  ${TAVO_GENERATED_DIR}/package/${PROJECT_NAME}ConfigVersion.cmake
  DESTINATION ${TAVO_PACKAGE_DIR})
