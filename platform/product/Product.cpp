#include "vk/Product.h"

#include "product/UniqueIdentifier.h"
#include "product/Widen.h"
#include "vk/Architecture.h"
#include "vk/HostFacts.h"
#include "vk/Kept.h"
#include "vk/Root.h"

#include <string_view>

namespace VK {

namespace {

struct Facts {
    std::string architecture;
    std::string rootDirectory;
    std::string uid;
};

/// A file's text up to the first blank or line end.
std::string readWord(const std::string& path) {
    const std::string text = Root::host().read(path).text;
    constexpr std::string_view ends(" \t\r\n\0", 5);
    return text.substr(0, text.find_first_of(ends));
}

std::string readMachineId() {
    const std::string id = readWord("/etc/machine-id");
    return id == "uninitialized" ? "" : id; // what it holds while the host boots for the first time
}

std::string withFinalSlash(std::string path) {
    if (path.empty() || path.back() != '/') path += '/';
    return path;
}

std::string readUid() {
    const std::string machineId = readMachineId();
    return uniqueIdentifier(machineId.empty() ? hostUuid() : machineId);
}

Facts readFacts() {
    const ProductOverrides given = productOverrides();
    return {given.architecture ? *given.architecture : architectureOf(Root::host()),
            withFinalSlash(given.rootDirectory ? *given.rootDirectory : VK_ROOT_DIRECTORY),
            given.uid ? *given.uid : readUid()};
}

std::shared_ptr<const Facts> facts() {
    static Kept<Facts> kept;
    return kept.get(readFacts);
}

} // namespace

std::wstring Product::getArchitecture() {
    return widen(facts()->architecture);
}
std::wstring Product::getRootDirectory() {
    return widen(facts()->rootDirectory);
}
std::wstring Product::getUid() {
    return widen(facts()->uid);
}

} // namespace VK
