# ufbx, an independent reader for comparison in benchmarks and tests. It is not packaged: its sources are looked for in
# the folder that TARNELL_PEERS names, else next to the project. Where they are, there is a target `ufbx`.
set(peers "$ENV{TARNELL_PEERS}")
if(NOT peers)
  set(peers "${PROJECT_SOURCE_DIR}/../shared/peers")
endif()
if(EXISTS "${peers}/ufbx/ufbx.c")
  enable_language(C)
  add_library(ufbx STATIC EXCLUDE_FROM_ALL "${peers}/ufbx/ufbx.c")
  target_include_directories(ufbx SYSTEM PUBLIC "${peers}/ufbx")
  target_link_libraries(ufbx PUBLIC m)
endif()
