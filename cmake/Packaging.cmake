# Packages: the provider, the tools and the development files, for Debian and for RPM systems. They are built by
# packaging/build, which configures a tree of its own with the prefix /usr.

set(VK_PACKAGE_CONTACT "VK base server provider <vk-baseserver@lists.vk.invalid>" CACHE STRING
    "Who maintains the packages, as NAME <ADDRESS>")

set(CPACK_PACKAGE_NAME vk-baseserver)
set(CPACK_PACKAGE_VENDOR ${VK_PROVIDER_VENDOR})
set(CPACK_PACKAGE_CONTACT ${VK_PACKAGE_CONTACT})
set(CPACK_PACKAGE_VERSION ${PROJECT_VERSION})
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY ${PROJECT_DESCRIPTION})
set(CPACK_COMPONENTS_ALL provider tools development)
set(CPACK_COMPONENT_PROVIDER_DESCRIPTION "Answers an object manager's questions about the server that it runs on:
the computer system, its chassis, its time service and how they belong
together. OpenPegasus and SFCB learn of it when it is installed.")
set(CPACK_COMPONENT_TOOLS_DESCRIPTION "Tools: a command that asks the provider without an object manager, a check
of what the provider needs of the host, and a command that copies what it
reads, for bug reports.")
set(CPACK_COMPONENT_DEVELOPMENT_DESCRIPTION "Development files: headers and links of the provider's platform libraries,
and CMPI headers.")
set(CPACK_VERBATIM_VARIABLES ON)
set(CPACK_STRIP_FILES ON)
# The prefix is known to the programs, so it cannot be changed while packing.
set(CPACK_SET_DESTDIR ON)
set(CPACK_PACKAGING_INSTALL_PREFIX ${CMAKE_INSTALL_PREFIX})

# What Debian asks of every package, and compressed manual pages.
option(VK_PACKAGING "Install for packages" OFF)
if(VK_PACKAGING)
    configure_file(packaging/debian/changelog.in ${CMAKE_BINARY_DIR}/packaging/changelog @ONLY)
    foreach(part IN ITEMS provider tools development)
        string(REPLACE development dev name vk-baseserver-${part})
        set(directory ${CMAKE_INSTALL_DATADIR}/doc/${name})
        install(FILES packaging/debian/copyright DESTINATION ${directory} COMPONENT ${part})
        install(FILES ${CMAKE_BINARY_DIR}/packaging/changelog DESTINATION ${directory} COMPONENT ${part})
        install(CODE "
            set(stage \"\$ENV{DESTDIR}\${CMAKE_INSTALL_PREFIX}\")
            file(GLOB pages \"\${stage}/${CMAKE_INSTALL_MANDIR}/man*/*.[1-8]\")
            execute_process(COMMAND gzip -9nf \${pages} \"\${stage}/${directory}/changelog\" COMMAND_ERROR_IS_FATAL ANY)"
            COMPONENT ${part})
    endforeach()
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
set(CPACK_DEBIAN_PROVIDER_PACKAGE_NAME vk-baseserver-provider)
set(CPACK_DEBIAN_PROVIDER_PACKAGE_DEPENDS python3)
set(CPACK_DEBIAN_PROVIDER_PACKAGE_SUGGESTS "tzdata, procps")
set(CPACK_DEBIAN_PROVIDER_PACKAGE_CONTROL_EXTRA ${scripts}/debian/postinst ${scripts}/debian/prerm ${scripts}/debian/postrm
    ${CMAKE_SOURCE_DIR}/packaging/debian/shlibs ${CMAKE_SOURCE_DIR}/packaging/debian/triggers)
set(CPACK_DEBIAN_PROVIDER_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_DEBIAN_TOOLS_PACKAGE_NAME vk-baseserver-tools)
set(CPACK_DEBIAN_TOOLS_PACKAGE_DEPENDS "vk-baseserver-provider (= ${PROJECT_VERSION})")
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_NAME vk-baseserver-dev)
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_SECTION libdevel)
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_DEPENDS "vk-baseserver-provider (= ${PROJECT_VERSION})")
# dpkg-shlibdeps finds our own libraries here; packaging/debian/shlibs, above, says which package holds them.
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS ${CMAKE_LIBRARY_OUTPUT_DIRECTORY})

set(CPACK_RPM_COMPONENT_INSTALL ON)
set(CPACK_RPM_FILE_NAME RPM-DEFAULT)
set(CPACK_RPM_PACKAGE_LICENSE "Proprietary")
set(CPACK_RPM_PACKAGE_GROUP "System Environment/Base")
set(CPACK_RPM_PACKAGE_AUTOREQPROV ON)
set(CPACK_RPM_PROVIDER_PACKAGE_NAME vk-baseserver-provider)
set(CPACK_RPM_PROVIDER_POST_INSTALL_SCRIPT_FILE ${scripts}/rpm/post)
set(CPACK_RPM_PROVIDER_PRE_UNINSTALL_SCRIPT_FILE ${scripts}/rpm/preun)
set(CPACK_RPM_PROVIDER_POST_UNINSTALL_SCRIPT_FILE ${scripts}/rpm/postun)
set(CPACK_RPM_TOOLS_PACKAGE_NAME vk-baseserver-tools)
set(CPACK_RPM_TOOLS_PACKAGE_REQUIRES "vk-baseserver-provider = ${PROJECT_VERSION}")
set(CPACK_RPM_DEVELOPMENT_PACKAGE_NAME vk-baseserver-devel)
set(CPACK_RPM_DEVELOPMENT_PACKAGE_REQUIRES "vk-baseserver-provider = ${PROJECT_VERSION}")
set(CPACK_RPM_EXCLUDE_FROM_AUTO_FILELIST_ADDITION /usr/sbin /usr/share/man /usr/share/man/man1 /usr/share/man/man7
    /usr/share/man/man8 /usr/lib64)
set(CPACK_RPM_SPEC_MORE_DEFINE "%define _build_id_links none")

set(CPACK_GENERATOR DEB)
include(CPack)
