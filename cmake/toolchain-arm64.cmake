# Debian's cross compiler for arm64, with arm64 libraries unpacked below VK_ARM64_SYSROOT (see .ci/arm64). Tests run under
# qemu's user-mode emulation.
set(CMAKE_SYSTEM_NAME Linux)
set(CMAKE_SYSTEM_PROCESSOR aarch64)
set(CMAKE_C_COMPILER aarch64-linux-gnu-gcc)
set(CMAKE_CXX_COMPILER aarch64-linux-gnu-g++)
set(CMAKE_LIBRARY_ARCHITECTURE aarch64-linux-gnu)

set(VK_ARM64_SYSROOT "" CACHE PATH "Directory with usr/include and usr/lib/aarch64-linux-gnu of the libraries")
list(APPEND CMAKE_TRY_COMPILE_PLATFORM_VARIABLES VK_ARM64_SYSROOT)
set(CMAKE_FIND_ROOT_PATH ${VK_ARM64_SYSROOT} /usr/aarch64-linux-gnu)
set(CMAKE_FIND_ROOT_PATH_MODE_PROGRAM NEVER)
set(CMAKE_FIND_ROOT_PATH_MODE_LIBRARY ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_INCLUDE ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_PACKAGE ONLY)
set(CMAKE_CROSSCOMPILING_EMULATOR qemu-aarch64;-L;/usr/aarch64-linux-gnu;-E;LD_LIBRARY_PATH=${VK_ARM64_SYSROOT}/usr/lib/aarch64-linux-gnu)

# Libraries of libraries are found there, too.
set(CMAKE_EXE_LINKER_FLAGS_INIT "-Wl,-rpath-link,${VK_ARM64_SYSROOT}/usr/lib/aarch64-linux-gnu")
