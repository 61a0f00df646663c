# The sources of a library compiled ten at a time: a third of the time, since most of it goes into headers that they share.
# It is for the trees of checks. The release tree compiles each source alone, and so finds out what one forgot to include.
# Left out is what has the same names in each of its sources: the broker's tables, the provider's operations.
foreach(target IN ITEMS vkcommon_inside vk-mof om_model om_mof vkcim_core cimxml endpoint endpoint_server vk_snapshot vk_check)
    if(TARGET ${target})
        set_target_properties(${target} PROPERTIES UNITY_BUILD ON UNITY_BUILD_BATCH_SIZE 10)
    endif()
endforeach()
