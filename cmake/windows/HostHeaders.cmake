# Libraries that are headers only are the same on all systems, so the build for Windows uses those of this machine. Each
# is linked into a folder of the build: next to them are the headers of another system.
set(GAITWRIGHT_HOST_HEADERS ${CMAKE_BINARY_DIR}/headers)

# gw_host_headers(TARGET NAME): a library whose headers are in /usr/include/NAME.
function(gw_host_headers target name)
  if(NOT EXISTS /usr/include/${name})
    message(FATAL_ERROR "The headers of ${name} are missing; ./build.sh windows installs them")
  endif()
  file(MAKE_DIRECTORY ${GAITWRIGHT_HOST_HEADERS})
  file(CREATE_LINK /usr/include/${name} ${GAITWRIGHT_HOST_HEADERS}/${name} SYMBOLIC)
  if(NOT TARGET ${target})
    add_library(${target} INTERFACE IMPORTED GLOBAL)
    target_include_directories(${target} SYSTEM INTERFACE ${GAITWRIGHT_HOST_HEADERS})
  endif()
endfunction()
