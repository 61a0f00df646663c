# What is installed where. Components: provider (libraries, schema, registration), tools, endpoint; Development.cmake has the fourth.

set(public_libraries nvlog vkcommon vkproduct vkinstrumentation vkproviderutilities)
set(runtime_libraries vknabaseserverprofileprovider ${public_libraries})

# An object manager may load the provider through a link in a directory of its own, and $ORIGIN is that directory then; so the
# installed libraries name their own directory as well. Which one that is becomes known when installing (--prefix): room for
# it is kept in the built libraries by a long name of the same place. In the system's own directory none is needed.
# It is built with the path to be installed, since CMake would end a path that it changes when installing with an empty
# element, and that stands for the directory a process is started in.
string(REPEAT "/." 200 room)
set_target_properties(${runtime_libraries} PROPERTIES BUILD_WITH_INSTALL_RPATH ON INSTALL_RPATH "$ORIGIN${room}")

if(VK_ENDPOINT)
    set(endpoint_targets cimxml endpoint endpoint_server vkcimd)
endif()

# Debug information names the sources from the tree's root on, not where the tree lay when it was built.
# gcov's notes name them as they are.
if(NOT VK_COVERAGE)
    foreach(target IN LISTS runtime_libraries ITEMS provider_parts vkcommon_inside om_schema om_model om_mof om_broker vkcim_terminal vkcim_core vkcim
            vk_command_line vk_snapshot vk-host-snapshot vk_check vk-provider-check ${endpoint_targets})
        target_compile_options(${target} PRIVATE
            -ffile-prefix-map=${CMAKE_SOURCE_DIR}/= -ffile-prefix-map=${CMAKE_BINARY_DIR}=build)
    endforeach()
endif()

install(TARGETS vknabaseserverprofileprovider
    LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT provider NAMELINK_COMPONENT development)
install(TARGETS ${public_libraries} EXPORT vk-baseserver
    LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT provider NAMELINK_COMPONENT development)
foreach(library IN LISTS runtime_libraries)
    install(CODE "
        set(library \"\$ENV{DESTDIR}\${CMAKE_INSTALL_PREFIX}/${CMAKE_INSTALL_LIBDIR}/lib${library}.so.1\")
        set(directory \"\${CMAKE_INSTALL_PREFIX}/${CMAKE_INSTALL_LIBDIR}\")
        if(directory MATCHES \"^/usr/lib(64|/[^/]*-linux-[^/]*)?\$\")
            file(RPATH_REMOVE FILE \"\${library}\")
        else()
            file(RPATH_SET FILE \"\${library}\" NEW_RPATH \"\\\$ORIGIN:\${directory}\")
        endif()" COMPONENT provider)
endforeach()
install(CODE "
    if(NOT CMAKE_INSTALL_PREFIX STREQUAL \"${CMAKE_INSTALL_PREFIX}\")
        message(NOTICE \"-- The provider looks for cimconfig in ${VK_COMMAND_FOLDER}: configure with the prefix to change that\")
    endif()" COMPONENT provider)

install(TARGETS vkcim RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR} COMPONENT tools)
install(TARGETS vk-host-snapshot vk-provider-check RUNTIME DESTINATION ${CMAKE_INSTALL_SBINDIR} COMPONENT tools)

install(FILES ${VK_SCHEMA_DIR}/vk-baseserver.mof ${VK_SCHEMA_DIR}/vk-baseserver-registration.mof
    ${VK_SCHEMA_DIR}/vk-baseserver.reg DESTINATION ${VK_SHARE_DIR} COMPONENT provider)

# Programs and texts with this build's names and directories in them.
function(vk_configured file destination component kind)
    get_filename_component(name ${file} NAME_WLE)
    configure_file(${file} ${CMAKE_BINARY_DIR}/installed/${name} @ONLY)
    install(${kind} ${CMAKE_BINARY_DIR}/installed/${name} DESTINATION ${destination} COMPONENT ${component})
endfunction()
vk_configured(tools/vk-provider-register.in ${CMAKE_INSTALL_SBINDIR} provider PROGRAMS)
install(DIRECTORY tools/register DESTINATION ${VK_SHARE_DIR} COMPONENT provider FILES_MATCHING PATTERN "*.py")
install(FILES ${VK_SCHEMA_DIR}/libvknabaseserverprofileprovider.7 DESTINATION ${CMAKE_INSTALL_MANDIR}/man7
    COMPONENT provider)
vk_configured(docs/man/vk-provider-register.8.in ${CMAKE_INSTALL_MANDIR}/man8 provider FILES)
vk_configured(docs/man/vk-provider-check.8.in ${CMAKE_INSTALL_MANDIR}/man8 tools FILES)
vk_configured(docs/man/vk-host-snapshot.8.in ${CMAKE_INSTALL_MANDIR}/man8 tools FILES)
vk_configured(docs/man/vkcim.1.in ${CMAKE_INSTALL_MANDIR}/man1 tools FILES)
install(FILES ${VK_SCHEMA_DIR}/vkcim.bash-completion DESTINATION ${CMAKE_INSTALL_DATADIR}/bash-completion/completions
    RENAME vkcim COMPONENT tools)
foreach(program IN ITEMS vk-provider-check vk-host-snapshot) # bash-completion looks for each by its name
    install(FILES tools/vk-tools.bash-completion DESTINATION ${CMAKE_INSTALL_DATADIR}/bash-completion/completions
        RENAME ${program} COMPONENT tools)
endforeach()
install(FILES ${VK_SCHEMA_DIR}/vkcim.schema.json docs/json/vkcim-facts.schema.json docs/json/vk-provider-check.schema.json
    DESTINATION ${CMAKE_INSTALL_DATADIR}/doc/vk-baseserver-tools COMPONENT tools)
install(FILES docs/examples/rack-server.json DESTINATION ${VK_SHARE_DIR}/examples COMPONENT tools)

if(VK_ENDPOINT)
    install(TARGETS vkcimd RUNTIME DESTINATION ${CMAKE_INSTALL_SBINDIR} COMPONENT endpoint)
    vk_configured(docs/man/vkcimd.8.in ${CMAKE_INSTALL_MANDIR}/man8 endpoint FILES)
    vk_configured(packaging/endpoint/vkcimd.service.in lib/systemd/system endpoint FILES)
    install(FILES packaging/endpoint/vkcimd.socket DESTINATION lib/systemd/system COMPONENT endpoint)
    install(FILES packaging/endpoint/vkcimd.conf DESTINATION ${CMAKE_INSTALL_SYSCONFDIR} COMPONENT endpoint)
    set(pam debian)
    if(CMAKE_INSTALL_LIBDIR STREQUAL lib64)
        set(pam rpm)
    endif()
    install(FILES packaging/endpoint/pam.${pam} DESTINATION ${CMAKE_INSTALL_SYSCONFDIR}/pam.d RENAME vkcimd COMPONENT endpoint)
endif()
