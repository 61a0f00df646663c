# The package of the endpoint. Where its libraries have other names in the next release, such as libcurl4t64, the packages
# there provide the old names.
vk_package(endpoint vk-baseserver-endpoint "CIM-XML endpoint of the CMPI provider for Linux servers"
"Answers CIM clients over a Unix socket, and over HTTPS where that is
configured. Started by the service manager when somebody asks.")

set(endpoint_scripts ${CMAKE_SOURCE_DIR}/packaging/endpoint)
set(CPACK_DEBIAN_ENDPOINT_PACKAGE_DEPENDS "vk-baseserver-provider (= ${PROJECT_VERSION}), adduser, libpam-modules, libpam-runtime")
set(CPACK_DEBIAN_ENDPOINT_PACKAGE_SUGGESTS sblim-wbemcli)
set(CPACK_DEBIAN_ENDPOINT_PACKAGE_CONTROL_EXTRA ${endpoint_scripts}/debian/postinst ${endpoint_scripts}/debian/prerm
    ${endpoint_scripts}/debian/postrm ${endpoint_scripts}/debian/conffiles)
set(CPACK_DEBIAN_ENDPOINT_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_RPM_ENDPOINT_PACKAGE_REQUIRES "vk-baseserver-provider = ${PROJECT_VERSION}, shadow-utils")
set(CPACK_RPM_ENDPOINT_POST_INSTALL_SCRIPT_FILE ${endpoint_scripts}/rpm/post)
set(CPACK_RPM_ENDPOINT_PRE_UNINSTALL_SCRIPT_FILE ${endpoint_scripts}/rpm/preun)
set(CPACK_RPM_ENDPOINT_POST_UNINSTALL_SCRIPT_FILE ${endpoint_scripts}/rpm/postun)
set(CPACK_RPM_ENDPOINT_USER_FILELIST "%config(noreplace) /etc/vkcimd.conf" "%config(noreplace) /etc/pam.d/vkcimd")
