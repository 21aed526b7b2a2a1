# Installed files, the CMake package and pkg-config.
include(CMakePackageConfigHelpers)

set(package_folder "${CMAKE_INSTALL_LIBDIR}/cmake/TarnellFbx")

install(DIRECTORY include/ DESTINATION "${CMAKE_INSTALL_INCLUDEDIR}/tarnell-fbx" FILES_MATCHING PATTERN "*.h")
if(NOT TARNELL_FBXSDK_ROOT)
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
configure_file(cmake/tarnell-fbx.pc.in "${PROJECT_BINARY_DIR}/tarnell-fbx.pc" @ONLY)
install(FILES "${PROJECT_BINARY_DIR}/tarnell-fbx.pc" DESTINATION "${CMAKE_INSTALL_LIBDIR}/pkgconfig")
if(TARNELL_FBX_TOOL)
  install(TARGETS tarnell-fbx-tool)
endif()
