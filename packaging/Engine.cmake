# The engine for other programs: find_package(Gaitwright), with one imported target per room; Gaitwright::app
# includes nearly all of them. See examples/convert.
include(CMakePackageConfigHelpers)

set(configs ${CMAKE_INSTALL_LIBDIR}/cmake/Gaitwright)
gw_rooms_seen(rooms gw_app gw_page gw_drivers)
foreach(room IN LISTS rooms)
  string(REGEX REPLACE "^gw_" "" name ${room})
  set_target_properties(${room} PROPERTIES EXPORT_NAME ${name})
  install(
    TARGETS ${room}
    EXPORT Gaitwright
    ARCHIVE DESTINATION ${GAITWRIGHT_PROGRAMS} COMPONENT develop
    FILE_SET HEADERS DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/gaitwright/${name} COMPONENT develop)
endforeach()
install(EXPORT Gaitwright NAMESPACE Gaitwright:: FILE GaitwrightTargets.cmake DESTINATION ${configs}
        COMPONENT develop)

configure_package_config_file(GaitwrightConfig.cmake.in GaitwrightConfig.cmake INSTALL_DESTINATION ${configs}
                              PATH_VARS GAITWRIGHT_SHARED NO_SET_AND_CHECK_MACRO)
write_basic_package_version_file(${CMAKE_CURRENT_BINARY_DIR}/GaitwrightConfigVersion.cmake
                                 COMPATIBILITY SameMajorVersion)
install(FILES ${CMAKE_CURRENT_BINARY_DIR}/GaitwrightConfig.cmake
              ${CMAKE_CURRENT_BINARY_DIR}/GaitwrightConfigVersion.cmake
        DESTINATION ${configs} COMPONENT develop)
