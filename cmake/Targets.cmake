# How our kinds of targets are made.

# vk_platform_library(NAME SOURCES... [LINK LIBS...]): one of the product's shared libraries, lib<NAME>.so.1.
function(vk_platform_library name)
    cmake_parse_arguments(ARG "" "" "LINK" ${ARGN})
    add_library(${name} SHARED ${ARG_UNPARSED_ARGUMENTS})
    set_target_properties(${name} PROPERTIES VERSION 1 SOVERSION 1)
    target_compile_options(${name} PRIVATE -fvisibility=default)
    target_include_directories(${name} PUBLIC "$<BUILD_INTERFACE:${CMAKE_SOURCE_DIR}/platform/include>"
        PRIVATE ${CMAKE_SOURCE_DIR}/platform)
    target_link_libraries(${name} PRIVATE vk_settings ${ARG_LINK})
endfunction()

# vk_built_for_tests(NAME): what belongs to the tests is built in half the time without optimisation and with the lines of
# its functions alone for debuggers; what is tested is built as it is shipped all the same.
add_library(vk_unoptimised INTERFACE)
target_compile_options(vk_unoptimised INTERFACE $<$<CONFIG:RelWithDebInfo>:-O0> -g1)
if(VK_SANITIZE MATCHES undefined)
    # Asked at every access of the product; a test's own wrong pointer crashes it or is the address sanitizer's.
    target_compile_options(vk_unoptimised INTERFACE -fno-sanitize=null,alignment,object-size,vptr)
endif()
function(vk_built_for_tests name)
    # In this order, as the last option counts.
    target_link_libraries(${name} PRIVATE vk_settings vk_unoptimised)
    set_target_properties(${name} PROPERTIES VK_UNOPTIMISED ON)
endfunction()

# vk_test(NAME SOURCES... [LINK LIBS...] [ENV VAR=VALUE...] [LABELS LABELS...] [COST SECONDS]): a GoogleTest program,
# each of its tests known to ctest, which begins with those of the highest cost.
function(vk_test name)
    cmake_parse_arguments(ARG "" "" "LINK;ENV;LABELS;COST" ${ARGN})
    add_executable(${name} ${ARG_UNPARSED_ARGUMENTS})
    target_include_directories(${name} PRIVATE ${CMAKE_SOURCE_DIR} ${CMAKE_SOURCE_DIR}/platform ${CMAKE_SOURCE_DIR}/tests)
    vk_built_for_tests(${name})
    target_link_libraries(${name} PRIVATE ${ARG_LINK} GTest::gmock_main)
    set_target_properties(${name} PROPERTIES RUNTIME_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/tests)
    if(TARGET test_headers)
        target_precompile_headers(${name} REUSE_FROM test_headers)
        # The product's sources are read by clang-tidy too, as they are compiled, and it reads no headers precompiled by gcc.
        set(of_product ${ARG_UNPARSED_ARGUMENTS})
        list(FILTER of_product INCLUDE REGEX "^/")
        list(FILTER of_product EXCLUDE REGEX "^${CMAKE_SOURCE_DIR}/tests/")
        set_source_files_properties(${of_product} PROPERTIES SKIP_PRECOMPILE_HEADERS ON)
    endif()
    # An empty value would vanish on the way, and the next property's name be taken for it.
    set(properties TIMEOUT 300)
    foreach(property IN ITEMS ENV LABELS COST)
        if(ARG_${property})
            string(REPLACE ";" "\\;" values "${ARG_${property}}")
            string(REPLACE ENV ENVIRONMENT property ${property})
            list(APPEND properties ${property} "${values}")
        endif()
    endforeach()
    gtest_discover_tests(${name} TEST_PREFIX ${name}. DISCOVERY_TIMEOUT 60 PROPERTIES ${properties})
endfunction()
