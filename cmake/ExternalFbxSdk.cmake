# An external FBX SDK, which the user owns, in place of the bundled platform: headers below include/, one library
# below lib/.
find_path(TARNELL_FBXSDK_INCLUDE fbxsdk.h PATHS "${TARNELL_FBXSDK_ROOT}/include" NO_DEFAULT_PATH REQUIRED)
file(GLOB_RECURSE external_libraries "${TARNELL_FBXSDK_ROOT}/lib/*/libfbxsdk.so" "${TARNELL_FBXSDK_ROOT}/lib/libfbxsdk.so")
if(NOT external_libraries)
  message(FATAL_ERROR "TARNELL_FBXSDK_ROOT: no libfbxsdk.so below ${TARNELL_FBXSDK_ROOT}/lib")
endif()
list(GET external_libraries 0 external_library)
# The name by which "FbxPlatform.h" includes the platform, whichever it is.
set(external_headers "${PROJECT_BINARY_DIR}/external-sdk")
file(CONFIGURE OUTPUT "${external_headers}/fbxsdk/Platform.h"
  CONTENT "#pragma once\n#include \"@TARNELL_FBXSDK_INCLUDE@/fbxsdk.h\"\n" @ONLY)
add_library(tarnell-fbxsdk SHARED IMPORTED GLOBAL)
set_target_properties(tarnell-fbxsdk PROPERTIES
  IMPORTED_LOCATION "${external_library}" INTERFACE_INCLUDE_DIRECTORIES "${external_headers};${TARNELL_FBXSDK_INCLUDE}")
