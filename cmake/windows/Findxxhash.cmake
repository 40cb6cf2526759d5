# The header contains the whole library.
include(HostHeaders)
if(NOT TARGET xxhash::xxhash)
  gw_host_headers(gw_xxhash_headers xxhash.h)
  set(source ${CMAKE_BINARY_DIR}/xxhash.cpp)
  file(CONFIGURE OUTPUT ${source} CONTENT
       "#define XXH_STATIC_LINKING_ONLY\n#define XXH_IMPLEMENTATION\n#include <xxhash.h>\n")
  add_library(gw_xxhash STATIC ${source})
  target_link_libraries(gw_xxhash PUBLIC gw_xxhash_headers)
  add_library(xxhash::xxhash ALIAS gw_xxhash)
endif()
set(xxhash_FOUND TRUE)
