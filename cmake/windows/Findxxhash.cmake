# The header contains the whole library.
include(HostHeaders)
gw_host_headers(xxhash::xxhash xxhash.h)
target_compile_definitions(xxhash::xxhash INTERFACE XXH_INLINE_ALL)
set(xxhash_FOUND TRUE)
