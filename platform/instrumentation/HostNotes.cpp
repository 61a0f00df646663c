#include "vk/HostNotes.h"

#include "vk/HostFacts.h"

void vkHostNotes(VkHostNote take, void* context) {
    for (const std::string& note : VK::hostNotes()) take(context, note.c_str());
}
