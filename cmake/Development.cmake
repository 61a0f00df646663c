# What programs are built with against the installed libraries: headers, pkg-config files and a CMake package.
include(CMakePackageConfigHelpers)

set(headers ${CMAKE_INSTALL_INCLUDEDIR}/vk-baseserver)
install(DIRECTORY platform/include/nvlog platform/include/vk platform/include/cmpi DESTINATION ${headers}
    COMPONENT development)

# Whoever uses the headers is compiled as C++17 at least, and finds them.
foreach(library IN LISTS public_libraries)
    target_compile_features(${library} INTERFACE cxx_std_17)
    target_include_directories(${library} INTERFACE $<INSTALL_INTERFACE:${headers}>)
endforeach()
# Its header names CMPI's types and VK::Moniker. Inside this tree each user links what it needs.
target_link_libraries(vkproviderutilities INTERFACE
    $<INSTALL_INTERFACE:vk-baseserver::cmpi> $<INSTALL_INTERFACE:vk-baseserver::vkcommon>)
set_target_properties(vk_cmpi PROPERTIES EXPORT_NAME cmpi)
target_include_directories(vk_cmpi INTERFACE $<INSTALL_INTERFACE:${headers}/cmpi>)

# find_package(vk-baseserver) supplies vk-baseserver::nvlog and so on, and vk-baseserver::cmpi for the CMPI headers alone.
set(package ${CMAKE_INSTALL_LIBDIR}/cmake/vk-baseserver)
set(version_file ${CMAKE_BINARY_DIR}/installed/vk-baseserver-config-version.cmake)
install(TARGETS vk_cmpi EXPORT vk-baseserver COMPONENT development)
install(EXPORT vk-baseserver NAMESPACE vk-baseserver:: FILE vk-baseserver-config.cmake DESTINATION ${package}
    COMPONENT development)
write_basic_package_version_file(${version_file} COMPATIBILITY SameMajorVersion)
install(FILES ${version_file} DESTINATION ${package} COMPONENT development)

# They name places from where they lie themselves, so that they are right below every prefix.
set(pkgconfig_directory ${CMAKE_INSTALL_FULL_LIBDIR}/pkgconfig)
file(RELATIVE_PATH VK_PKGCONFIG_TO_PREFIX ${pkgconfig_directory} ${CMAKE_INSTALL_PREFIX})
string(REGEX REPLACE "/$" "" VK_PKGCONFIG_TO_PREFIX ${VK_PKGCONFIG_TO_PREFIX})
file(RELATIVE_PATH VK_PREFIX_TO_LIBDIR ${CMAKE_INSTALL_PREFIX} ${CMAKE_INSTALL_FULL_LIBDIR})
file(RELATIVE_PATH VK_PREFIX_TO_HEADERS ${CMAKE_INSTALL_PREFIX} ${CMAKE_INSTALL_FULL_INCLUDEDIR}/vk-baseserver)

# vk_pkgconfig(NAME DESCRIPTION FLAGS LIBS [REQUIRES]): NAME.pc.
function(vk_pkgconfig name description flags libs)
    set(requires ${ARGN})
    configure_file(cmake/library.pc.in ${CMAKE_BINARY_DIR}/installed/${name}.pc @ONLY)
    install(FILES ${CMAKE_BINARY_DIR}/installed/${name}.pc DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig
        COMPONENT development)
endfunction()
function(vk_pkgconfig_library name description)
    vk_pkgconfig(${name} "${description}" "-I\${includedir}" "-L\${libdir} -l${name}" ${ARGN})
endfunction()
vk_pkgconfig(vk-cmpi "CMPI headers of level 200"
    "-I\${includedir}/cmpi -DCMPI_PLATFORM_LINUX_GENERIC_GNU -DCMPI_VERSION=200" "")
vk_pkgconfig_library(nvlog "Logger of the base server provider")
vk_pkgconfig_library(vkcommon "Monikers, date-times and host files of the base server provider")
vk_pkgconfig_library(vkproduct "Architecture and unique identifier of a host")
vk_pkgconfig_library(vkinstrumentation "Cursor over what a host says of itself")
vk_pkgconfig_library(vkproviderutilities "What a CMPI provider does with paths and instances" "vk-cmpi, vkcommon")
