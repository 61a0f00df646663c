# How our kinds of targets are made.

# vk_platform_library(NAME SOURCES... [LINK LIBS...]): one of the product's shared libraries, lib<NAME>.so.1.
function(vk_platform_library name)
    cmake_parse_arguments(ARG "" "" "LINK" ${ARGN})
    add_library(${name} SHARED ${ARG_UNPARSED_ARGUMENTS})
    set_target_properties(${name} PROPERTIES VERSION 1 SOVERSION 1)
    target_compile_options(${name} PRIVATE -fvisibility=default)
    target_include_directories(${name} PUBLIC ${CMAKE_SOURCE_DIR}/platform/include PRIVATE ${CMAKE_SOURCE_DIR}/platform)
    target_link_libraries(${name} PRIVATE vk_settings ${ARG_LINK})
endfunction()

# vk_built_for_tests(NAME): what belongs to the tests is built in half the time without optimisation and with the lines of
# its functions alone for debuggers; what is tested is built as it is shipped all the same.
function(vk_built_for_tests name)
    target_compile_options(${name} PRIVATE $<$<CONFIG:RelWithDebInfo>:-O0> -g1)
    set_target_properties(${name} PROPERTIES VK_UNOPTIMISED ON)
endfunction()

# vk_test(NAME SOURCES... [LINK LIBS...] [ENV VAR=VALUE...]): a GoogleTest program, each of its tests known to ctest.
function(vk_test name)
    cmake_parse_arguments(ARG "" "" "LINK;ENV;LABELS" ${ARGN})
    add_executable(${name} ${ARG_UNPARSED_ARGUMENTS})
    target_include_directories(${name} PRIVATE ${CMAKE_SOURCE_DIR} ${CMAKE_SOURCE_DIR}/platform ${CMAKE_SOURCE_DIR}/tests)
    target_link_libraries(${name} PRIVATE vk_settings ${ARG_LINK} GTest::gmock_main)
    vk_built_for_tests(${name})
    set_target_properties(${name} PROPERTIES RUNTIME_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/tests)
    if(TARGET test_headers)
        target_precompile_headers(${name} REUSE_FROM test_headers)
    endif()
    # An empty value would vanish on the way, and the next property's name be taken for it.
    set(properties TIMEOUT 300)
    foreach(property IN ITEMS ENV LABELS)
        if(ARG_${property})
            string(REPLACE ";" "\\;" values "${ARG_${property}}")
            string(REPLACE ENV ENVIRONMENT property ${property})
            list(APPEND properties ${property} "${values}")
        endif()
    endforeach()
    gtest_discover_tests(${name} TEST_PREFIX ${name}. DISCOVERY_TIMEOUT 60 PROPERTIES ${properties})
endfunction()
