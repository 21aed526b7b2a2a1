# Installed files, the CMake package and pkg-config.
include(CMakePackageConfigHelpers)

set(package_folder "${CMAKE_INSTALL_LIBDIR}/cmake/TarnellFbx")

# Wherever it is installed, the library finds the platform next to it, and the tool finds both.
file(RELATIVE_PATH programs_to_libraries "${CMAKE_INSTALL_FULL_BINDIR}" "${CMAKE_INSTALL_FULL_LIBDIR}")
if(NOT TARNELL_FBXSDK_ROOT)
  set_target_properties(tarnell-fbx PROPERTIES INSTALL_RPATH "$ORIGIN")
endif()

install(DIRECTORY include/ DESTINATION "${CMAKE_INSTALL_INCLUDEDIR}/tarnell-fbx" FILES_MATCHING PATTERN "*.h")
if(TARNELL_FBXSDK_ROOT)
  # Hosts find the external SDK themselves: no package of ours can say where it is.
  install(TARGETS tarnell-fbx)
else()
  set(pkgconfig_platform_libraries " -ltarnell-fbxsdk")
  set(pkgconfig_platform_includes " -I\${includedir}/platform")
  install(DIRECTORY fbxsdk/include/ DESTINATION "${CMAKE_INSTALL_INCLUDEDIR}/tarnell-fbx/platform"
    FILES_MATCHING PATTERN "*.h")
  install(TARGETS tarnell-fbx tarnell-fbxsdk EXPORT TarnellFbxTargets)
  install(EXPORT TarnellFbxTargets NAMESPACE TarnellFbx:: DESTINATION "${package_folder}")
  configure_package_config_file(cmake/TarnellFbxConfig.cmake.in "${PROJECT_BINARY_DIR}/TarnellFbxConfig.cmake"
    INSTALL_DESTINATION "${package_folder}")
  write_basic_package_version_file("${PROJECT_BINARY_DIR}/TarnellFbxConfigVersion.cmake" COMPATIBILITY SameMajorVersion)
  install(FILES "${PROJECT_BINARY_DIR}/TarnellFbxConfig.cmake" "${PROJECT_BINARY_DIR}/TarnellFbxConfigVersion.cmake"
    DESTINATION "${package_folder}")
endif()
# Relative, so that it holds for any prefix that is chosen later.
file(RELATIVE_PATH pkgconfig_to_prefix "${CMAKE_INSTALL_FULL_LIBDIR}/pkgconfig" "${CMAKE_INSTALL_PREFIX}")
configure_file(cmake/tarnell-fbx.pc.in "${PROJECT_BINARY_DIR}/tarnell-fbx.pc" @ONLY)
install(FILES "${PROJECT_BINARY_DIR}/tarnell-fbx.pc" DESTINATION "${CMAKE_INSTALL_LIBDIR}/pkgconfig")
if(TARNELL_FBX_TOOL)
  set_target_properties(tarnell-fbx-tool PROPERTIES INSTALL_RPATH "$ORIGIN/${programs_to_libraries}")
  install(TARGETS tarnell-fbx-tool)
endif()
