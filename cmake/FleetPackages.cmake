# What hands a host to the programs that look after many: the component and package ansible, and in tools what writes
# metrics. Nothing of it does anything by being installed but Ansible's fact script, and that when Ansible asks.

install(PROGRAMS tools/ansible/vk.fact DESTINATION ${CMAKE_INSTALL_SYSCONFDIR}/ansible/facts.d COMPONENT ansible)
install(DIRECTORY tools/ansible/collection/
    DESTINATION ${CMAKE_INSTALL_DATADIR}/ansible/collections/ansible_collections/vk/baseserver COMPONENT ansible)

vk_package(ansible vk-baseserver-ansible "Ansible facts and modules for the CMPI provider for Linux servers"
"On hosts that Ansible looks after: a script for facts, ansible_local.vk. Where
Ansible runs: a collection with a table of the hosts and a module that sets
their time service.")
set(CPACK_DEBIAN_ANSIBLE_PACKAGE_ARCHITECTURE all)
set(CPACK_DEBIAN_ANSIBLE_PACKAGE_SHLIBDEPS OFF)
set(CPACK_DEBIAN_ANSIBLE_PACKAGE_RECOMMENDS vk-baseserver-tools)
set(CPACK_DEBIAN_ANSIBLE_PACKAGE_ENHANCES ansible-core)
set(CPACK_DEBIAN_ANSIBLE_PACKAGE_CONTROL_EXTRA ${CMAKE_SOURCE_DIR}/packaging/ansible/conffiles)
set(CPACK_DEBIAN_ANSIBLE_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_RPM_ANSIBLE_PACKAGE_ARCHITECTURE noarch)
set(CPACK_RPM_ANSIBLE_USER_FILELIST "%config(noreplace) /etc/ansible/facts.d/vk.fact")

install(PROGRAMS tools/metrics/vk-metrics DESTINATION lib/vk/metrics COMPONENT tools)
vk_configured(packaging/metrics/vk-metrics.service.in lib/systemd/system tools FILES)
install(FILES packaging/metrics/vk-metrics.timer DESTINATION lib/systemd/system COMPONENT tools)
install(FILES tools/metrics/vk-rules.yml tools/metrics/vk-dashboard.json DESTINATION ${VK_SHARE_DIR}/prometheus COMPONENT tools)
set(CPACK_DEBIAN_TOOLS_PACKAGE_SUGGESTS prometheus-node-exporter)
set(CPACK_DEBIAN_TOOLS_PACKAGE_CONTROL_EXTRA ${CMAKE_SOURCE_DIR}/packaging/metrics/prerm)
set(CPACK_DEBIAN_TOOLS_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_RPM_TOOLS_PRE_UNINSTALL_SCRIPT_FILE ${CMAKE_SOURCE_DIR}/packaging/metrics/preun)
