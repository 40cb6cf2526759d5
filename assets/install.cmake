# Copies the data files beside the executables. Stock profiles are told from a user's own by being read-only.
file(GLOB data ${FROM}/*.htr ${FROM}/*.bsm)
file(GLOB profiles ${FROM}/*.prf)
file(GLOB installed ${TO}/*.prf) # a profile that is stock no more goes, too
foreach(source IN LISTS data installed)
  get_filename_component(name ${source} NAME)
  file(REMOVE ${TO}/${name})
endforeach()
file(COPY ${data} ${FROM}/Content DESTINATION ${TO})
file(COPY ${profiles} DESTINATION ${TO} FILE_PERMISSIONS OWNER_READ GROUP_READ WORLD_READ)
# One file with all of them, which takes less time to read: name and size in a line, then the bytes.
set(pack "")
foreach(source IN LISTS profiles)
  get_filename_component(name ${source} NAME)
  file(SIZE ${source} size)
  file(READ ${source} text)
  string(APPEND pack "${name} ${size}\n${text}")
endforeach()
file(WRITE ${TO}/profiles.pack "${pack}")
