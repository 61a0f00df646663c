# The optional component ntp and its package: what has the time service's fixed commands work with today's NTP daemons.
# Nothing here is found by anybody before vk-ntp-setup has linked it.

set(VK_NTP_DIR lib/vk/ntp)
install(PROGRAMS tools/ntp/ntpd tools/ntp/ntp DESTINATION ${VK_NTP_DIR} COMPONENT ntp)
install(FILES tools/ntp/daemons.sh DESTINATION ${VK_NTP_DIR} COMPONENT ntp)
file(RELATIVE_PATH VK_SBINDIR_TO_NTP ${CMAKE_INSTALL_FULL_SBINDIR} ${CMAKE_INSTALL_PREFIX}/${VK_NTP_DIR})
vk_configured(tools/ntp/vk-ntp-setup.in ${CMAKE_INSTALL_SBINDIR} ntp PROGRAMS)
vk_configured(docs/man/vk-ntp-setup.8.in ${CMAKE_INSTALL_MANDIR}/man8 ntp FILES)

vk_package(ntp vk-baseserver-ntp "NTP daemons of today for a CMPI provider's time service"
"Has the time service's method that sets the clock work with chrony, ntpsec,
systemd-timesyncd and openntpd. It does nothing before vk-ntp-setup is run.")
set(CPACK_DEBIAN_NTP_PACKAGE_ARCHITECTURE all)
set(CPACK_DEBIAN_NTP_PACKAGE_SHLIBDEPS OFF)
set(CPACK_DEBIAN_NTP_PACKAGE_SUGGESTS "chrony | time-daemon, procps") # a recommended daemon would begin to run
set(CPACK_DEBIAN_NTP_PACKAGE_ENHANCES vk-baseserver-provider)
set(CPACK_DEBIAN_NTP_PACKAGE_CONTROL_EXTRA ${CMAKE_SOURCE_DIR}/packaging/ntp/prerm)
set(CPACK_DEBIAN_NTP_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_RPM_NTP_PACKAGE_ARCHITECTURE noarch)
set(CPACK_RPM_NTP_PRE_UNINSTALL_SCRIPT_FILE ${CMAKE_SOURCE_DIR}/packaging/ntp/preun)
