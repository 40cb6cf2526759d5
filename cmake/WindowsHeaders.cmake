# Libraries that are headers only are the same on all systems, so the build for Windows uses those of this machine. Only
# they are linked into a folder of the build: next to them are the headers of another system.
set(headers ${CMAKE_BINARY_DIR}/headers)
file(MAKE_DIRECTORY ${headers})
foreach(name IN ITEMS CLI nlohmann xxhash.h)
  file(CREATE_LINK /usr/include/${name} ${headers}/${name} SYMBOLIC)
endforeach()

foreach(library IN ITEMS CLI11::CLI11 nlohmann_json::nlohmann_json)
  add_library(${library} INTERFACE IMPORTED GLOBAL)
  target_include_directories(${library} SYSTEM INTERFACE ${headers})
endforeach()
