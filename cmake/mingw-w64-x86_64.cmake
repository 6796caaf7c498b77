# Cross-compiles for 64-bit Windows with Debian's mingw-w64 (the posix thread
# model, for std::thread and friends): apt-get install g++-mingw-w64-x86-64-posix
set(CMAKE_SYSTEM_NAME Windows)
set(CMAKE_SYSTEM_PROCESSOR x86_64)

set(KAVU_MINGW_TRIPLE x86_64-w64-mingw32)
set(CMAKE_C_COMPILER ${KAVU_MINGW_TRIPLE}-gcc-posix)
set(CMAKE_CXX_COMPILER ${KAVU_MINGW_TRIPLE}-g++-posix)
set(CMAKE_RC_COMPILER ${KAVU_MINGW_TRIPLE}-windres)

set(CMAKE_FIND_ROOT_PATH /usr/${KAVU_MINGW_TRIPLE})
set(CMAKE_FIND_ROOT_PATH_MODE_PROGRAM NEVER)
set(CMAKE_FIND_ROOT_PATH_MODE_LIBRARY ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_INCLUDE ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_PACKAGE ONLY)

# The program must run on a Windows machine without the compiler's DLLs.
set(CMAKE_EXE_LINKER_FLAGS_INIT "-static -static-libgcc -static-libstdc++")

# Windows programs run under Wine, in a prefix of the build folder (its first
# start is slow; it never touches the user's own ~/.wine).
set(CMAKE_CROSSCOMPILING_EMULATOR env WINEPREFIX=${CMAKE_CURRENT_LIST_DIR}/../build/wine
                                      WINEDEBUG=-all wine)
