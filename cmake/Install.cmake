# Installed files, the CMake package and pkg-config.
