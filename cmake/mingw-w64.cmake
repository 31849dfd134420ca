# Cross-build for 64-bit Windows with Debian's MinGW-w64 (the core and the command line; Qt for
# Windows is not available here). Used by scripts/test.sh to keep the Windows backends compiling.
set(CMAKE_SYSTEM_NAME Windows)
set(CMAKE_C_COMPILER x86_64-w64-mingw32-gcc-posix)
set(CMAKE_CXX_COMPILER x86_64-w64-mingw32-g++-posix)
set(CMAKE_FIND_ROOT_PATH_MODE_PROGRAM NEVER)
# One self-contained program: no MinGW runtime DLLs to ship beside it.
set(CMAKE_EXE_LINKER_FLAGS_INIT "-static")
