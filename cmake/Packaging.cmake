# Packages: the provider, the tools and the development files, for Debian and for RPM systems. They are built by
# packaging/build, which configures a tree of its own with the prefix /usr.

set(VK_PACKAGE_CONTACT "VK base server provider <vk-baseserver@lists.vk.invalid>" CACHE STRING
    "Who maintains the packages, as NAME <ADDRESS>")

set(CPACK_PACKAGE_NAME vk-baseserver)
set(CPACK_PACKAGE_VENDOR ${VK_PROVIDER_VENDOR})
set(CPACK_PACKAGE_CONTACT ${VK_PACKAGE_CONTACT})
set(CPACK_PACKAGE_VERSION ${PROJECT_VERSION})
# One for all packages would come before each one's own.
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "")

# vk_package(COMPONENT NAME SYNOPSIS DESCRIPTION): a package of that component. A macro, since CPack reads the variables.
macro(vk_package component name synopsis description)
    string(TOUPPER ${component} package)
    list(APPEND CPACK_COMPONENTS_ALL ${component})
    set(CPACK_COMPONENT_${package}_DESCRIPTION "${description}")
    set(CPACK_DEBIAN_${package}_PACKAGE_NAME ${name})
    set(CPACK_DEBIAN_${package}_DESCRIPTION "${synopsis}\n${description}")
    set(CPACK_RPM_${package}_PACKAGE_SUMMARY "${synopsis}")
    string(REGEX REPLACE "-dev$" "-devel" CPACK_RPM_${package}_PACKAGE_NAME ${name})
endmacro()
vk_package(provider vk-baseserver-provider "CMPI management provider for Linux servers"
"Answers an object manager's questions about the server that it runs on:
the computer system, its chassis, its time service and how they belong
together. OpenPegasus and SFCB learn of it when it is installed.")
vk_package(tools vk-baseserver-tools "commands to try and check the CMPI provider for Linux servers"
"A command that asks the provider without an object manager, a check of what
the provider needs of the host, and a command that copies what it reads, for
bug reports.")
vk_package(development vk-baseserver-dev "headers of the CMPI provider's platform libraries"
"Headers and links of the libraries below the provider, the CMPI headers, and
what pkg-config and CMake need to find them.")
set(CPACK_VERBATIM_VARIABLES ON)
set(VK_PACKAGING "" CACHE STRING "Install for packages of that kind: deb or rpm")
# Debian's packages of debug symbols take them from what is installed, and strip it then.
if(VK_PACKAGING STREQUAL deb)
    set(CPACK_DEBIAN_DEBUGINFO_PACKAGE ON)
else()
    set(CPACK_STRIP_FILES ON)
endif()
# The prefix is known to the programs, so it cannot be changed while packing.
set(CPACK_SET_DESTDIR ON)
set(CPACK_PACKAGING_INSTALL_PREFIX ${CMAKE_INSTALL_PREFIX})
include(NtpPackage)
include(FleetPackages)
if(VK_ENDPOINT)
    include(EndpointPackage)
endif()

# What Debian asks of every package, and compressed manual pages.
if(VK_PACKAGING)
    configure_file(packaging/debian/changelog.in ${CMAKE_BINARY_DIR}/packaging/changelog @ONLY)
    foreach(part IN LISTS CPACK_COMPONENTS_ALL)
        string(TOUPPER ${part} package)
        set(directory ${CMAKE_INSTALL_DATADIR}/doc/${CPACK_DEBIAN_${package}_PACKAGE_NAME})
        install(FILES packaging/debian/copyright DESTINATION ${directory} COMPONENT ${part})
        install(FILES ${CMAKE_BINARY_DIR}/packaging/changelog DESTINATION ${directory} COMPONENT ${part})
        install(CODE "
            set(stage \"\$ENV{DESTDIR}\${CMAKE_INSTALL_PREFIX}\")
            file(GLOB pages \"\${stage}/${CMAKE_INSTALL_MANDIR}/man*/*.[1-8]\")
            execute_process(COMMAND gzip -9nf \${pages} \"\${stage}/${directory}/changelog\" COMMAND_ERROR_IS_FATAL ANY)"
            COMPONENT ${part})
    endforeach()
endif()
if(VK_PACKAGING STREQUAL deb)
    install(FILES packaging/debian/lintian-overrides DESTINATION ${CMAKE_INSTALL_DATADIR}/lintian/overrides
        RENAME vk-baseserver-provider COMPONENT provider)
endif()

# What the maintainer scripts need of this build.
file(READ packaging/bring-zone-back.sh VK_BRING_ZONE_BACK)
set(scripts ${CMAKE_BINARY_DIR}/packaging)
foreach(script IN ITEMS debian/postinst debian/prerm debian/postrm rpm/post rpm/preun rpm/postun)
    configure_file(packaging/${script}.in ${scripts}/${script} @ONLY FILE_PERMISSIONS
        OWNER_READ OWNER_WRITE OWNER_EXECUTE GROUP_READ GROUP_EXECUTE WORLD_READ WORLD_EXECUTE)
endforeach()

set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_SECTION admin)
set(CPACK_DEBIAN_PROVIDER_PACKAGE_DEPENDS python3)
set(CPACK_DEBIAN_PROVIDER_PACKAGE_SUGGESTS "tzdata, procps")
set(CPACK_DEBIAN_PROVIDER_PACKAGE_CONTROL_EXTRA ${scripts}/debian/postinst ${scripts}/debian/prerm ${scripts}/debian/postrm
    ${CMAKE_SOURCE_DIR}/packaging/debian/shlibs ${scripts}/debian/symbols ${CMAKE_SOURCE_DIR}/packaging/debian/triggers)
set(CPACK_DEBIAN_PROVIDER_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_DEBIAN_TOOLS_PACKAGE_DEPENDS "vk-baseserver-provider (= ${PROJECT_VERSION})")
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_SECTION libdevel)
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_DEPENDS "vk-baseserver-provider (= ${PROJECT_VERSION})")
# dpkg-shlibdeps finds our own libraries here; packaging/debian/shlibs, above, says which package holds them.
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS ${CMAKE_LIBRARY_OUTPUT_DIRECTORY})

set(CPACK_RPM_COMPONENT_INSTALL ON)
set(CPACK_RPM_FILE_NAME RPM-DEFAULT)
set(CPACK_RPM_PACKAGE_LICENSE "Proprietary")
set(CPACK_RPM_PACKAGE_GROUP "System Environment/Base")
set(CPACK_RPM_PACKAGE_AUTOREQPROV ON)
set(CPACK_RPM_PROVIDER_POST_INSTALL_SCRIPT_FILE ${scripts}/rpm/post)
set(CPACK_RPM_PROVIDER_PRE_UNINSTALL_SCRIPT_FILE ${scripts}/rpm/preun)
set(CPACK_RPM_PROVIDER_POST_UNINSTALL_SCRIPT_FILE ${scripts}/rpm/postun)
set(CPACK_RPM_TOOLS_PACKAGE_REQUIRES "vk-baseserver-provider = ${PROJECT_VERSION}")
set(CPACK_RPM_DEVELOPMENT_PACKAGE_REQUIRES "vk-baseserver-provider = ${PROJECT_VERSION}")
set(CPACK_RPM_EXCLUDE_FROM_AUTO_FILELIST_ADDITION /usr/sbin /usr/share/man /usr/share/man/man1 /usr/share/man/man7
    /usr/share/man/man8 /usr/lib64 /usr/lib/systemd /usr/lib/systemd/system /etc/pam.d)
set(CPACK_RPM_SPEC_MORE_DEFINE "%define _build_id_links none")

set(CPACK_GENERATOR DEB)
include(CPack)
