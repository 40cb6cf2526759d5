# The folders of an installation. The programs are next to their modules, and links to them are on the search path of
# shells. Programs find all other files relative to themselves, so an installation can be moved as a whole.
if(CMAKE_LIBRARY_ARCHITECTURE AND (NOT DEFINED CMAKE_INSTALL_LIBDIR OR CMAKE_INSTALL_LIBDIR STREQUAL "lib"))
  # As in Debian. By default, CMake does this only for the prefix /usr, which is not the prefix of a packaged build,
  # and it keeps "lib" in a build folder that was configured with it.
  set(CMAKE_INSTALL_LIBDIR lib/${CMAKE_LIBRARY_ARCHITECTURE} CACHE PATH "Object code libraries" FORCE)
endif()
include(GNUInstallDirs)

set(GAITWRIGHT_PROGRAMS ${CMAKE_INSTALL_LIBDIR}/gaitwright)
set(GAITWRIGHT_SHARED ${CMAKE_INSTALL_DATADIR}/gaitwright)
set(GAITWRIGHT_PYTHON lib/python3/dist-packages)
file(RELATIVE_PATH GAITWRIGHT_SHARED_FROM_PROGRAMS ${CMAKE_INSTALL_FULL_LIBDIR}/gaitwright
     ${CMAKE_INSTALL_FULL_DATADIR}/gaitwright)

# gw_rooms_seen(RESULT targets...): sets RESULT to the targets and all rooms that they see.
function(gw_rooms_seen result)
  set(ahead ${ARGN})
  set(seen)
  while(ahead)
    list(POP_FRONT ahead room)
    if(TARGET ${room} AND room MATCHES "^gw_" AND NOT room IN_LIST seen)
      list(APPEND seen ${room})
      get_target_property(links ${room} LINK_LIBRARIES)
      if(links)
        list(APPEND ahead ${links})
      endif()
    endif()
  endwhile()
  set(${result} ${seen} PARENT_SCOPE)
endfunction()

# gw_modules_below(RESULT FOLDER): sets RESULT to the modules that a folder and its subfolders build next to the
# programs.
function(gw_modules_below result folder)
  get_directory_property(targets DIRECTORY ${folder} BUILDSYSTEM_TARGETS)
  get_directory_property(folders DIRECTORY ${folder} SUBDIRECTORIES)
  set(modules)
  foreach(target IN LISTS targets)
    get_target_property(type ${target} TYPE)
    get_target_property(output ${target} LIBRARY_OUTPUT_DIRECTORY)
    if(type STREQUAL MODULE_LIBRARY AND output STREQUAL CMAKE_RUNTIME_OUTPUT_DIRECTORY)
      list(APPEND modules ${target})
    endif()
  endforeach()
  foreach(below IN LISTS folders)
    gw_modules_below(more ${below})
    list(APPEND modules ${more})
  endforeach()
  set(${result} ${modules} PARENT_SCOPE)
endfunction()
