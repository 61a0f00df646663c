#pragma once

extern "C" {

/// Receives one note, a text in UTF-8 that is valid during the call.
typedef void (*VkHostNote)(void* context, const char* note);

/// Hands over VK::hostNotes() (vk/HostFacts.h) one by one, in order. For programs that look the function up in a
/// library that is loaded already: libvkinstrumentation has it under this very name.
void vkHostNotes(VkHostNote take, void* context);

/// Hands over why nothing can be read of the process's snapshot or simulated host, with the directory's or file's name:
/// it is missing, may not be read or is broken. Nothing at all where it can be read. This and the next one are
/// libvkcommon's and are looked up by name, too, so that a library that stands in for libvkcommon need not have them.
void vkHostProblem(VkHostNote take, void* context);

/// Hands over which host it is where it is not this one: `the snapshot in DIRECTORY`, `the simulated host in FILE`.
void vkHostSource(VkHostNote take, void* context);

/// Hands over the host's time, a CIM date-time, and how many minutes its local time is ahead of UTC, a number in
/// decimal. Nothing at all where it does not say.
void vkHostTime(VkHostNote take, void* context);
void vkHostOffset(VkHostNote take, void* context);

} // extern "C"
