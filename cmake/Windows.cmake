# The toolchain that builds for Windows on Debian, with its package g++-mingw-w64-x86-64-posix. Tests run under wine.
set(CMAKE_SYSTEM_NAME Windows)
set(CMAKE_SYSTEM_PROCESSOR x86_64)
set(CMAKE_C_COMPILER x86_64-w64-mingw32-gcc-posix)
set(CMAKE_CXX_COMPILER x86_64-w64-mingw32-g++-posix)
set(CMAKE_RC_COMPILER x86_64-w64-mingw32-windres)
set(CMAKE_CROSSCOMPILING_EMULATOR ${CMAKE_CURRENT_LIST_DIR}/windows/emulate.sh)

# Libraries are the compiler's own. The modules in cmake/windows find those that are headers only, or sources.
set(CMAKE_FIND_ROOT_PATH /usr/x86_64-w64-mingw32)
set(CMAKE_FIND_ROOT_PATH_MODE_PROGRAM NEVER)
set(CMAKE_FIND_ROOT_PATH_MODE_LIBRARY ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_INCLUDE ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_PACKAGE ONLY)

# The programs need none of the compiler's own libraries where they run.
# As much stack as elsewhere, since trees can be thousands of nodes deep.
set(CMAKE_EXE_LINKER_FLAGS_INIT "-static -Wl,--stack,8388608")
set(CMAKE_SHARED_LINKER_FLAGS_INIT -static)
set(CMAKE_MODULE_LINKER_FLAGS_INIT -static)

# Windows 10 is the oldest that is supported. Texts are wide, and sizes of files have 64 bits.
add_compile_definitions(_WIN32_WINNT=0x0A00 UNICODE _UNICODE _FILE_OFFSET_BITS=64
                        __USE_MINGW_ANSI_STDIO=1)
