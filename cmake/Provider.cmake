# What object managers know the provider by, and where its parts lie to each other once installed.

set(VK_PROVIDER_NAME BaseServerProvider) # the prefix of the factory functions
set(VK_PROVIDER_MODULE VKBaseServerModule)
set(VK_PROVIDER_LOCATION vknabaseserverprofileprovider) # the library's name
set(VK_PROVIDER_NAMESPACE root/cimv2)
set(VK_PROVIDER_VENDOR VK)

# The product's root directory, with a final slash.
set(VK_ROOT_DIRECTORY ${CMAKE_INSTALL_PREFIX}/lib/vk/platform/)
# For the single sources that use it: with another prefix nothing else is compiled anew.
set(vk_root_definition "VK_ROOT_DIRECTORY=\"${VK_ROOT_DIRECTORY}\"")
# Where the provider looks for the object manager's command cimconfig.
set(VK_COMMAND_FOLDER ${CMAKE_INSTALL_PREFIX}/lib/vk/vcm/bin)
set(VK_MULTIARCH ${CMAKE_LIBRARY_ARCHITECTURE})
set(VK_SHARE_DIR ${CMAKE_INSTALL_DATADIR}/vk-baseserver)
file(RELATIVE_PATH VK_SBINDIR_TO_LIBDIR ${CMAKE_INSTALL_FULL_SBINDIR} ${CMAKE_INSTALL_FULL_LIBDIR})
file(RELATIVE_PATH VK_SBINDIR_TO_DATADIR ${CMAKE_INSTALL_FULL_SBINDIR} ${CMAKE_INSTALL_FULL_DATADIR})
