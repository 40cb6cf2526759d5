list(APPEND CMAKE_MODULE_PATH ${PROJECT_SOURCE_DIR}/cmake)

# Every folder is one target, created by these functions. A target sees only the headers of its own folder and of the
# targets that it names.

find_program(GAITWRIGHT_CCACHE ccache)
if(GAITWRIGHT_CCACHE)
  set(CMAKE_CXX_COMPILER_LAUNCHER ${GAITWRIGHT_CCACHE})
endif()

# Hardening of release builds. In the rooms with inner loops, checking containers and every function's stack would
# cost 6 percent of a conversion, so only functions with buffers are checked there.
set(GAITWRIGHT_INNER_ROOMS gw_math gw_base gw_scene gw_motion gw_retarget)
set(GAITWRIGHT_HARDENING -U_FORTIFY_SOURCE -D_FORTIFY_SOURCE=2)
set(GAITWRIGHT_HARDENING_INNER ${GAITWRIGHT_HARDENING} -fstack-protector)
set(GAITWRIGHT_HARDENING_OUTER ${GAITWRIGHT_HARDENING} -fstack-protector-strong -D_GLIBCXX_ASSERTIONS)

function(gw_harden target)
  if(WIN32)
    # The other checks need a library of this compiler, which costs more than they do.
    target_compile_options(${target} PRIVATE "$<$<CONFIG:Release>:-D_GLIBCXX_ASSERTIONS>")
    return()
  endif()
  set(hardening ${GAITWRIGHT_HARDENING_OUTER})
  if(target IN_LIST GAITWRIGHT_INNER_ROOMS)
    set(hardening ${GAITWRIGHT_HARDENING_INNER})
  endif()
  target_compile_options(${target} PRIVATE "$<$<CONFIG:Release>:${hardening}>")
  target_link_options(${target} PRIVATE "$<$<CONFIG:Release>:-Wl,-z,relro,-z,now>")
endfunction()

# Compile options that every target of the project shares.
function(gw_compile_options target)
  # No contraction, so that results are bit-identical at every optimization level.
  target_compile_options(
    ${target}
    PRIVATE -ffp-contract=off
            -Wall
            -Wextra
            -Wshadow
            -Wconversion
            -Wnon-virtual-dtor
            -Woverloaded-virtual)
  if(NOT GAITWRIGHT_SANITIZE AND NOT GAITWRIGHT_FUZZ AND NOT GAITWRIGHT_THREADS)
    gw_harden(${target})
    # Then the linker can leave out single functions. A smaller program starts faster, because the system maps the
    # neighbors of each page that is used.
    target_compile_options(${target} PRIVATE "$<$<CONFIG:Release>:-ffunction-sections>")
  endif()
  if(GAITWRIGHT_THREADS)
    target_compile_options(${target} PRIVATE -O1 -fsanitize=thread -fno-omit-frame-pointer)
    target_link_options(${target} PRIVATE -fsanitize=thread)
  endif()
  if(GAITWRIGHT_SANITIZE)
    target_compile_options(${target} PRIVATE -O1 -fsanitize=address,undefined -fno-sanitize-recover=all
                                             -fno-omit-frame-pointer -D_GLIBCXX_ASSERTIONS)
    target_link_options(${target} PRIVATE -fsanitize=address,undefined)
  endif()
  if(GAITWRIGHT_FUZZ)
    # Coverage that guides the fuzzer.
    target_compile_options(${target} PRIVATE -fsanitize=fuzzer-no-link)
  endif()
endfunction()

# Compiles a target's sources eight at a time, if the preset says so. To the compiler, a source that another one
# includes is a header, where types of unnamed namespaces are suspect.
function(gw_join_sources target)
  if(GAITWRIGHT_UNITY)
    set_target_properties(${target} PROPERTIES UNITY_BUILD ON UNITY_BUILD_BATCH_SIZE 8)
    target_compile_options(${target} PRIVATE -Wno-subobject-linkage)
  endif()
endfunction()

# A room's sources for one system only are in a folder below it with that system's name.
set(GAITWRIGHT_SYSTEM posix)
if(WIN32)
  set(GAITWRIGHT_SYSTEM windows)
  list(PREPEND CMAKE_MODULE_PATH ${PROJECT_SOURCE_DIR}/cmake/windows)
endif()

# gw_room(NAME [PUBLIC targets...] [PRIVATE targets...]): a library of all sources in the current folder, and in the one
# for the system that it is built for.
function(gw_room name)
  cmake_parse_arguments(ROOM "" "" "PUBLIC;PRIVATE" ${ARGN})
  file(GLOB sources CONFIGURE_DEPENDS *.cpp ${GAITWRIGHT_SYSTEM}/*.cpp)
  file(GLOB headers CONFIGURE_DEPENDS *.h)
  file(GLOB system_headers CONFIGURE_DEPENDS ${GAITWRIGHT_SYSTEM}/*.h)
  add_library(${name} STATIC ${sources})
  target_sources(${name} PUBLIC FILE_SET HEADERS BASE_DIRS ${CMAKE_CURRENT_SOURCE_DIR} FILES ${headers})
  if(system_headers)
    target_sources(${name} PUBLIC FILE_SET system_headers TYPE HEADERS BASE_DIRS
                                  ${CMAKE_CURRENT_SOURCE_DIR}/${GAITWRIGHT_SYSTEM} FILES ${system_headers})
  endif()
  target_link_libraries(${name} PUBLIC ${ROOM_PUBLIC} PRIVATE ${ROOM_PRIVATE})
  target_compile_features(${name} PUBLIC cxx_std_20)
  set_target_properties(${name} PROPERTIES VERIFY_INTERFACE_HEADER_SETS ON)
  gw_join_sources(${name})
  if(WIN32)
    # The system's headers define macros with common names, so those who include them are compiled by themselves.
    file(GLOB system_sources ${GAITWRIGHT_SYSTEM}/*.cpp)
    set_source_files_properties(${system_sources} PROPERTIES SKIP_UNITY_BUILD_INCLUSION ON)
  endif()
  gw_compile_options(${name})
endfunction()

# gw_tests(NAME targets...): one test program of all sources in the current folder, and in the one for the system that
# it is built for.
function(gw_tests name)
  file(GLOB sources CONFIGURE_DEPENDS *.cpp ${GAITWRIGHT_SYSTEM}/*.cpp)
  add_executable(${name} ${sources})
  target_include_directories(${name} PRIVATE ${CMAKE_CURRENT_SOURCE_DIR})
  target_link_libraries(${name} PRIVATE ${ARGN} gw_test_support GTest::gmock GTest::gtest_main)
  gw_compile_options(${name})
  # Tests are compiled once for each run, and the libraries that they test are optimized as usual.
  target_compile_options(${name} PRIVATE $<$<CONFIG:Release>:-O1>)
  gtest_discover_tests(${name} DISCOVERY_TIMEOUT 60 PROPERTIES TIMEOUT 300)
endfunction()
