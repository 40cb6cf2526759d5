# The test framework, built from its sources for Windows.
find_path(GAITWRIGHT_GTEST_SOURCES googletest/CMakeLists.txt PATHS /usr/src/googletest NO_DEFAULT_PATH
          NO_CMAKE_FIND_ROOT_PATH REQUIRED)
set(INSTALL_GTEST OFF CACHE BOOL "" FORCE)
if(NOT TARGET GTest::gtest)
  add_subdirectory(${GAITWRIGHT_GTEST_SOURCES} ${CMAKE_BINARY_DIR}/googletest EXCLUDE_FROM_ALL)
endif()
set(GTest_FOUND TRUE)
