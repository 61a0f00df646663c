#pragma once

extern "C" {

/// Receives one note, a text in UTF-8 that is valid during the call.
typedef void (*VkHostNote)(void* context, const char* note);

/// Hands over VK::hostNotes() (vk/HostFacts.h) one by one, in order. For programs that look the function up in a
/// library that is loaded already: libvkinstrumentation has it under this very name.
void vkHostNotes(VkHostNote take, void* context);

} // extern "C"
