#include "tools/snapshot/MaskedFiles.h"

#include "host/SmbiosTable.h"

#include <algorithm>
#include <set>
#include <vector>

namespace snapshot {

using VK::Host::SmbiosStructure;
using VK::Host::SmbiosVersion;

namespace {

constexpr unsigned int firmware = 0;
constexpr unsigned int systemType = 1;
constexpr unsigned int baseBoardType = 2;
constexpr unsigned int chassis = 3;
constexpr char endOfTable = 127;
constexpr std::size_t header = 4;
constexpr std::size_t uuidAt = 0x08;
constexpr std::size_t uuidLength = 16;

using Offsets = std::vector<std::size_t>;

/// Where a structure holds what is the same on many machines; everything else is emptied.
struct Kept {
    Offsets texts;   ///< numbers of strings
    Offsets serials; ///< numbers of strings that identify a machine: masked
    Offsets numbers;
};

Offsets range(Offsets offsets, std::size_t begin, std::size_t end) {
    while (begin < end) offsets.push_back(begin++);
    return offsets;
}

Kept keptOf(const SmbiosStructure& structure) {
    switch (structure.type()) {
    case firmware:
        return {{0x04, 0x05, 0x08}, {}, range({0x06, 0x07}, 0x09, 0x1A)};
    case systemType:
        return {{0x04, 0x05, 0x06, 0x19}, {0x07}, {0x18}};
    case baseBoardType:
        return {{0x04, 0x05}, {}, {}};
    case chassis: {
        Kept kept{{0x04, 0x06}, {0x07, 0x08}, range(range({0x05}, 0x09, 0x0D), 0x11, 0x15)};
        // The elements contained stand before the last text.
        if (const auto size = structure.byteAt(0x14)) kept.texts.push_back(0x15 + *structure.byteAt(0x13) * *size);
        return kept;
    }
    default:
        return {};
    }
}

class MaskedTable {
public:
    MaskedTable(const std::string& table, SmbiosVersion tableVersion, Mask& ofRun)
        : bytes(table), version(tableVersion), mask(ofRun) {}

    /// The structures one by one, then what stands behind them.
    std::string make() {
        masked.clear();
        VK::Host::SmbiosTable table(bytes);
        while (const auto structure = table.next()) add(*structure);
        addRest(std::string_view(bytes).substr(masked.size()));
        return masked;
    }

private:
    void add(const SmbiosStructure& structure) {
        const std::size_t begin = masked.size();
        const std::size_t length = *structure.byteAt(1);
        const Kept kept = keptOf(structure);
        masked.append(bytes, begin, header).append(length - header, '\0');
        for (const Offsets& offsets : {kept.texts, kept.serials, kept.numbers})
            for (const std::size_t offset : offsets)
                if (offset < length) masked[begin + offset] = bytes[begin + offset];
        if (const auto uuid = structure.bytesAt(uuidAt, uuidLength); uuid && structure.type() == systemType)
            masked.replace(begin + uuidAt, uuidLength, maskedUuid(*uuid));
        const std::string_view strings = structure.contents().second;
        addStrings(strings, numbersAt(structure, kept.texts), numbersAt(structure, kept.serials));
        masked.append(strings.empty() ? 2 : 1, '\0');
    }

    static std::set<unsigned int> numbersAt(const SmbiosStructure& structure, const Offsets& offsets) {
        std::set<unsigned int> numbers;
        for (const std::size_t offset : offsets)
            if (const auto number = structure.byteAt(offset)) numbers.insert(*number);
        return numbers;
    }

    void addStrings(std::string_view strings, const std::set<unsigned int>& texts,
                    const std::set<unsigned int>& serials) {
        for (unsigned int number = 1; !strings.empty(); ++number) {
            const std::string text(strings.substr(0, strings.find('\0')));
            strings.remove_prefix(text.size() + 1);
            if (serials.contains(number))
                masked += mask.serial(text);
            else
                masked += texts.contains(number) ? mask.everywhere(text) : std::string(text.size(), 'x');
            masked += '\0';
        }
    }

    std::string maskedUuid(std::string_view stored) const {
        const std::string inOrder = bytesOfDigits(mask.uuid(VK::Host::uuidFromBytes(stored, version)));
        return bytesOfDigits(VK::Host::uuidFromBytes(inOrder, version)); // back by the same exchange of bytes
    }

    void addRest(std::string_view rest) {
        if (rest.find_first_not_of('\0') == std::string_view::npos) {
            masked += rest;
            return;
        }
        // A table that is broken stays so, in the same way.
        const bool isEnd = rest.front() == endOfTable;
        const std::string_view kept = rest.substr(0, isEnd ? header : 2);
        masked.append(kept).append(rest.size() - kept.size(), isEnd ? '\0' : 'x');
    }

    const std::string& bytes;
    SmbiosVersion version;
    Mask& mask;
    std::string masked;
};

} // namespace

std::string maskedTable(const std::string& table, std::string_view entryPoint, Mask& mask) {
    MaskedTable masked(table, VK::Host::parseSmbiosEntryPoint(entryPoint).version, mask);
    masked.make(); // learns the serial numbers that are masked in other texts, too
    return masked.make();
}

} // namespace snapshot
