# What every target of ours is compiled with. Targets link vk_settings; the CMPI headers come from vk_cmpi.

set(CMPI_INCLUDE_DIR "${CMAKE_SOURCE_DIR}/platform/include/cmpi" CACHE PATH "Directory that holds cmpidt.h, cmpift.h and cmpimacs.h")
set(VK_SANITIZE "" CACHE STRING "Sanitizers to build with, as -fsanitize takes them")
option(VK_FUZZ "Build the fuzz targets (clang only)" OFF)
option(VK_COVERAGE "Build for coverage" OFF)
option(VK_JOINED "Compile several sources of a library at once (by default as VK_JOINED in the environment)" $ENV{VK_JOINED})

if(NOT CMAKE_BUILD_TYPE AND NOT CMAKE_CONFIGURATION_TYPES)
    set(CMAKE_BUILD_TYPE RelWithDebInfo CACHE STRING "" FORCE)
endif()

set(CMAKE_CXX_STANDARD 20)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_C_STANDARD 11)
set(CMAKE_C_STANDARD_REQUIRED ON)
set(CMAKE_C_EXTENSIONS OFF)
set(CMAKE_CXX_VISIBILITY_PRESET hidden)
set(CMAKE_C_VISIBILITY_PRESET hidden)
set(CMAKE_VISIBILITY_INLINES_HIDDEN ON)
set(CMAKE_POSITION_INDEPENDENT_CODE ON)
set(CMAKE_EXPORT_COMPILE_COMMANDS ON)
set(CMAKE_LIBRARY_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/lib)
set(CMAKE_ARCHIVE_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/lib)
set(CMAKE_RUNTIME_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/bin)
set(CMAKE_BUILD_RPATH_USE_ORIGIN ON)
# The linker's own list of what it read holds blanks of paths as they are, and what has one in its path would be linked again
# each time. Linker scripts are named with LINK_DEPENDS.
set(CMAKE_LINK_DEPENDS_USE_LINKER OFF)

add_library(vk_settings INTERFACE)
target_compile_options(vk_settings INTERFACE
    -Wall -Wextra -Wpedantic -Wconversion -Wshadow -Werror
    -fstack-protector-strong)
target_link_options(vk_settings INTERFACE -Wl,-z,relro,-z,now,-z,noexecstack -Wl,--as-needed)
if(VK_SANITIZE)
    target_compile_options(vk_settings INTERFACE -fsanitize=${VK_SANITIZE} -fno-sanitize-recover=all -fno-omit-frame-pointer)
    target_link_options(vk_settings INTERFACE -fsanitize=${VK_SANITIZE})
else()
    target_link_options(vk_settings INTERFACE $<$<CXX_COMPILER_ID:GNU>:-Wl,--no-undefined>)
endif()
if(VK_FUZZ)
    target_compile_options(vk_settings INTERFACE -fsanitize=fuzzer-no-link)
endif()
if(VK_COVERAGE)
    # Counted by gcc, in a file beside each object; all programs and libraries that hold the object add to it. Threads
    # count, too.
    target_compile_options(vk_settings INTERFACE -O0 --coverage -fprofile-abs-path -fprofile-update=atomic)
    target_compile_definitions(vk_settings INTERFACE VK_COVERAGE)
    target_link_options(vk_settings INTERFACE --coverage)
endif()
if(NOT CMAKE_BUILD_TYPE STREQUAL "Debug" AND NOT VK_COVERAGE AND NOT VK_SANITIZE)
    # Some distributions' compilers set a level of their own. It wants optimisation, which test programs do without.
    target_compile_options(vk_settings INTERFACE -U_FORTIFY_SOURCE
        $<$<NOT:$<BOOL:$<TARGET_PROPERTY:VK_UNOPTIMISED>>>:-D_FORTIFY_SOURCE=2>)
endif()

# The CMPI headers, ours or others'; the provider and the broker are written to level 200.
add_library(vk_cmpi INTERFACE)
target_include_directories(vk_cmpi SYSTEM INTERFACE "$<BUILD_INTERFACE:${CMPI_INCLUDE_DIR}>")
target_compile_definitions(vk_cmpi INTERFACE CMPI_PLATFORM_LINUX_GENERIC_GNU CMPI_VERSION=200)
