# Debian packages of the components.
set(CPACK_PACKAGE_NAME gaitwright)
set(CPACK_PACKAGE_CONTACT "Gaitwright developers <gaitwright@example.org>")
set(CPACK_PACKAGE_VENDOR "Gaitwright developers")
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
set(CPACK_GENERATOR DEB)
set(CPACK_STRIP_FILES ON)
set(CPACK_INSTALL_DEFAULT_DIRECTORY_PERMISSIONS OWNER_READ OWNER_WRITE OWNER_EXECUTE GROUP_READ GROUP_EXECUTE
                                                WORLD_READ WORLD_EXECUTE)
set(CPACK_COMPONENTS_ALL ${GAITWRIGHT_COMPONENTS})
set(CPACK_COMPONENTS_GROUPING IGNORE)
set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_COMPRESSION_TYPE xz)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS ${CMAKE_RUNTIME_OUTPUT_DIRECTORY}) # our own library
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)

foreach(component package IN ZIP_LISTS GAITWRIGHT_COMPONENTS GAITWRIGHT_PACKAGES)
  string(TOUPPER ${component} COMPONENT)
  set(CPACK_DEBIAN_${COMPONENT}_PACKAGE_NAME ${package})
endforeach()

# Pictures are drawn by a driver that is loaded by name.
set(CPACK_DEBIAN_SHELL_PACKAGE_SECTION graphics)
set(CPACK_DEBIAN_SHELL_PACKAGE_RECOMMENDS "libgl1-mesa-dri, gaitwright-import")
set(CPACK_COMPONENT_SHELL_DESCRIPTION
    "motion capture converted to one fixed skeleton, in the shell
Reads BVH, HTR, CHA and CHB motions, scene containers with keyframed bones
and, with gaitwright-import, FBX, glTF and Collada files. It moves them onto
the target skeleton by a bone map, plants the feet, and writes Kinetra
files. Whole archives convert in one run.
.
This package holds the command line program, which needs no display, the
target skeleton and the bone maps of common conventions.")

set(CPACK_DEBIAN_IMPORT_PACKAGE_SECTION graphics)
set(CPACK_DEBIAN_IMPORT_PACKAGE_DEPENDS "gaitwright (= ${PROJECT_VERSION})")
set(CPACK_COMPONENT_IMPORT_DESCRIPTION
    "FBX, glTF and Collada motions for Gaitwright
The program that Gaitwright starts to read the files of modeling programs: the
skeleton with its rest pose and its clips. It runs in a process with little
memory, time and no network, because such files come from anywhere.")

# The window system plugin and the fonts are loaded by name too.
set(CPACK_DEBIAN_DESKTOP_PACKAGE_SECTION graphics)
set(CPACK_DEBIAN_DESKTOP_PACKAGE_DEPENDS
    "gaitwright (= ${PROJECT_VERSION}), qt6-qpa-plugins, libgl1-mesa-dri")
set(CPACK_DEBIAN_DESKTOP_PACKAGE_RECOMMENDS "fonts-dejavu-core | fonts-freefont-ttf")
set(CPACK_COMPONENT_DESKTOP_DESCRIPTION
    "motion capture converted to one fixed skeleton, in a window
Opens a BVH, HTR, CHA or CHB motion and, with gaitwright-import, an FBX, glTF
or Collada file, converts it by a bone map, plays source and result side by
side, and saves a Kinetra file. An editor makes and changes bone maps.")

# The data of a conversion are in the shell's package.
set(CPACK_DEBIAN_LIBRARY_PACKAGE_SECTION libs)
set(CPACK_DEBIAN_LIBRARY_PACKAGE_DEPENDS "gaitwright (= ${PROJECT_VERSION})")
set(CPACK_DEBIAN_LIBRARY_PACKAGE_RECOMMENDS gaitwright-import)
# Debian runs ldconfig by a trigger. CPack would add scripts that run it too, unless the package names its own scripts;
# the two that are named here do not exist, and CPack only warns about them.
set(control ${CMAKE_CURRENT_BINARY_DIR}/control)
file(WRITE ${control}/triggers "activate-noawait ldconfig\n")
file(WRITE ${control}/shlibs
     "libgaitwright ${PROJECT_VERSION_MAJOR}.${PROJECT_VERSION_MINOR} ${GAITWRIGHT_LIBRARY} (>= ${PROJECT_VERSION})\n")
set(CPACK_DEBIAN_LIBRARY_PACKAGE_CONTROL_EXTRA
    "${control}/triggers;${control}/shlibs;${control}/postinst;${control}/postrm")
set(CPACK_COMPONENT_LIBRARY_DESCRIPTION
    "motion capture converted to one fixed skeleton, shared library
Reads motions, moves them onto the target skeleton with a bone map, measures
the results and writes them, for programs that do this themselves.")

set(CPACK_DEBIAN_DEVELOP_PACKAGE_SECTION libdevel)
set(CPACK_DEBIAN_DEVELOP_PACKAGE_SHLIBDEPS OFF) # the package has no shared libraries
set(CPACK_DEBIAN_DEVELOP_PACKAGE_DEPENDS "${GAITWRIGHT_LIBRARY} (= ${PROJECT_VERSION})")
set(CPACK_COMPONENT_DEVELOP_DESCRIPTION
    "motion capture converted to one fixed skeleton, development files
The header of the Gaitwright library, with which programs read, convert,
measure and write motions, a CMake package and a file for pkg-config.")

# An extension module runs in one version of Python. numpy is loaded with the first array.
set(CPACK_DEBIAN_PYTHON_PACKAGE_SECTION python)
set(CPACK_DEBIAN_PYTHON_PACKAGE_DEPENDS
    "${GAITWRIGHT_LIBRARY} (= ${PROJECT_VERSION}), python3 (>= ${GAITWRIGHT_PYTHON_VERSION}~), \
python3 (<< ${GAITWRIGHT_PYTHON_NEXT}), python3-numpy")
set(CPACK_COMPONENT_PYTHON_DESCRIPTION
    "motion capture converted to one fixed skeleton, Python module
Reads motions as numpy arrays, moves them onto the target skeleton with a bone
map, measures the results and writes them.")

include(CPack)
