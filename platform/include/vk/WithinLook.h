#pragma once

/// Calls `work` with `data` while the calling thread takes one look at the host: each file of a snapshot or of a
/// simulated host is asked once whether it has changed, and all cursors of the thread see the host as it was then, or
/// as the thread itself changed it. What `work` throws is thrown. Of this host it changes nothing.
///
/// libvkcommon's. Who can do without it looks it up by this name, so that a library that stands in for libvkcommon need
/// not have it.
extern "C" void vkWithinLook(void (*work)(void*), void* data);
