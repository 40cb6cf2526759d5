# The library for other programs: find_package(Gaitwright) with the target Gaitwright::gaitwright, or pkg-config. See
# examples/convert.
include(CMakePackageConfigHelpers)

set(configs ${CMAKE_INSTALL_LIBDIR}/cmake/Gaitwright)
install(
  TARGETS libgaitwright
  EXPORT Gaitwright
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT library NAMELINK_COMPONENT develop
  FILE_SET HEADERS DESTINATION ${CMAKE_INSTALL_INCLUDEDIR} COMPONENT develop)
install(EXPORT Gaitwright NAMESPACE Gaitwright:: FILE GaitwrightTargets.cmake DESTINATION ${configs}
        COMPONENT develop)

configure_package_config_file(GaitwrightConfig.cmake.in GaitwrightConfig.cmake INSTALL_DESTINATION ${configs}
                              PATH_VARS GAITWRIGHT_SHARED NO_SET_AND_CHECK_MACRO)
write_basic_package_version_file(${CMAKE_CURRENT_BINARY_DIR}/GaitwrightConfigVersion.cmake
                                 COMPATIBILITY SameMajorVersion)
install(FILES ${CMAKE_CURRENT_BINARY_DIR}/GaitwrightConfig.cmake
              ${CMAKE_CURRENT_BINARY_DIR}/GaitwrightConfigVersion.cmake
        DESTINATION ${configs} COMPONENT develop)

# For pkg-config, relative to the file itself, so an installation can be moved. Another one is for the build.
file(RELATIVE_PATH pc_prefix ${CMAKE_INSTALL_FULL_LIBDIR}/pkgconfig ${CMAKE_INSTALL_PREFIX})
set(pc_prefix "\${pcfiledir}/${pc_prefix}")
set(pc_include "\${prefix}/${CMAKE_INSTALL_INCLUDEDIR}")
set(pc_library "\${prefix}/${CMAKE_INSTALL_LIBDIR}")
configure_file(gaitwright.pc.in gaitwright.pc @ONLY)
install(FILES ${CMAKE_CURRENT_BINARY_DIR}/gaitwright.pc DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig
        COMPONENT develop)
set(pc_prefix ${CMAKE_BINARY_DIR})
set(pc_include ${PROJECT_SOURCE_DIR}/library/include)
set(pc_library ${CMAKE_RUNTIME_OUTPUT_DIRECTORY})
configure_file(gaitwright.pc.in ${CMAKE_BINARY_DIR}/pkgconfig/gaitwright.pc @ONLY)
