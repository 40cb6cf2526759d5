# The archive: one library less for each start of the program to load (docs/adr/0004).
find_path(XXHASH_INCLUDE_DIR xxhash.h REQUIRED)
find_library(XXHASH_LIBRARY libxxhash.a REQUIRED)
if(NOT TARGET xxhash::xxhash)
  add_library(xxhash::xxhash STATIC IMPORTED GLOBAL)
  set_target_properties(xxhash::xxhash PROPERTIES IMPORTED_LOCATION ${XXHASH_LIBRARY}
                                                  INTERFACE_INCLUDE_DIRECTORIES ${XXHASH_INCLUDE_DIR})
endif()
set(xxhash_FOUND TRUE)
