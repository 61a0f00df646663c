#include "common/Text.h"
#include "fuzz/Expect.h"
#include "host/Placeholder.h"
#include "host/Smbios.h"

#include <algorithm>
#include <tuple>

namespace {

using namespace VK;
using namespace VK::Host;
using fuzz::expect;

/// An entry point of version 3 without a fault, so that the table's parser is reached whatever the table is.
std::string rightEntryPoint() {
    std::string bytes("_SM3_\0\x18\3\2\0\1\0\xFF\xFF\x0F\0\0\0\0\0\0\0\0\0", 24);
    unsigned int sum = 0;
    for (const char c : bytes) sum += static_cast<unsigned char>(c);
    bytes[5] = static_cast<char>(0x100 - (sum & 0xFF));
    return bytes;
}

auto allOf(const SmbiosSystem& system) {
    return std::tie(system.manufacturer, system.product, system.version, system.serial, system.sku, system.uuid);
}

auto allOf(const SmbiosBaseBoard& board) {
    return std::tie(board.manufacturer, board.product);
}

auto allOf(const SmbiosChassis& chassis) {
    return std::tie(chassis.manufacturer, chassis.version, chassis.serial, chassis.sku, chassis.type,
                    chassis.bootUpState, chassis.powerSupplyState, chassis.thermalState);
}

bool isClean(const std::string& text) {
    return text.size() <= longestText && trimmed(text) == text &&
           std::all_of(text.begin(), text.end(), [](char c) { return c >= ' ' && c <= '~'; });
}

void checkText(const std::string& text) {
    expect(isClean(text), "a text is not clean");
    for (const FirmwareText kind : {FirmwareText::Other, FirmwareText::Model, FirmwareText::ChassisSku})
        expect(isPlaceholder(text, kind) == isPlaceholder(". " + lowerCase(text) + " .", kind),
               "a placeholder hangs on its letter case, or on what stands around it");
}

/// Empty, or groups of 8, 4, 4, 4 and 12 digits.
bool isUuid(const std::string& text) {
    constexpr std::string_view shape = "00000000-0000-0000-0000-000000000000";
    return text.empty() || std::equal(text.begin(), text.end(), shape.begin(), shape.end(), [](char c, char like) {
               return like == '-' ? c == '-' : (c >= '0' && c <= '9') || (c >= 'a' && c <= 'f');
           });
}

void checkTexts(const Smbios& smbios) {
    if (const auto& system = smbios.system) {
        for (const auto* text :
             {&system->manufacturer, &system->product, &system->version, &system->serial, &system->sku})
            checkText(*text);
        expect(isUuid(system->uuid), "the system's UUID is none");
        expect(isUuid(uuidFromText(system->uuid)), "the system's UUID is none as text");
    }
    if (const auto& board = smbios.baseBoard) {
        checkText(board->manufacturer);
        checkText(board->product);
    }
    for (const SmbiosChassis& chassis : smbios.chassis) {
        for (const auto* text : {&chassis.manufacturer, &chassis.version, &chassis.serial, &chassis.sku})
            checkText(*text);
        expect(chassis.type <= 127, "the lock bit was left in a chassis' type");
        expect(std::max({chassis.bootUpState, chassis.powerSupplyState, chassis.thermalState}) <= 255, "no byte");
    }
}

/// Whether one is what the other begins with.
void checkBegin(const Smbios& begin, const Smbios& whole) {
    if (begin.system)
        expect(whole.system && allOf(*begin.system) == allOf(*whole.system), "what follows changed the system");
    if (begin.baseBoard)
        expect(whole.baseBoard && allOf(*begin.baseBoard) == allOf(*whole.baseBoard), "what follows changed the board");
    expect(begin.chassis.size() <= whole.chassis.size(), "what follows took a chassis away");
    for (std::size_t i = 0; i < begin.chassis.size(); ++i)
        expect(allOf(begin.chassis[i]) == allOf(whole.chassis[i]), "what follows changed a chassis");
}

/// How many times a table can hold the bytes that a structure has at least: a header and the end of its strings.
std::size_t mostStructures(std::string_view table) {
    return table.size() / 6;
}

void checkTable(std::string_view table) {
    const std::string entryPoint = rightEntryPoint();
    const Smbios smbios = parseSmbios(entryPoint, table);
    expect(smbios.entryPointProblem.empty(), "a right entry point is refused");
    expect(smbios.chassis.size() + (smbios.system ? 1 : 0) <= mostStructures(table), "more than the table holds");
    expect(smbios.problems.size() <= 2, "more problems than there are kinds of them");
    checkTexts(smbios);
    const Smbios again = parseSmbios(entryPoint, table);
    checkBegin(again, smbios);
    checkBegin(smbios, again);
    expect(again.problems == smbios.problems, "other problems the second time");
    // What stands before the place where a table breaks off is read.
    checkBegin(parseSmbios(entryPoint, table.substr(0, table.size() / 2)), smbios);
    if (!table.empty()) checkBegin(parseSmbios(entryPoint, table.substr(0, table.size() - 1)), smbios);
}

} // namespace

/// The first byte is the length of the entry point that follows it; the rest is the table.
extern "C" int LLVMFuzzerTestOneInput(const unsigned char* data, std::size_t size) {
    if (size == 0) return 0;
    const std::string_view bytes(reinterpret_cast<const char*>(data) + 1, size - 1);
    const std::size_t length = std::min<std::size_t>(data[0], bytes.size());
    const std::string_view table = bytes.substr(length);
    const Smbios smbios = parseSmbios(bytes.substr(0, length), table);
    checkTexts(smbios);
    if (!smbios.entryPointProblem.empty())
        expect(!smbios.system && !smbios.baseBoard && smbios.chassis.empty() && smbios.problems.empty(),
               "a refused table was read");
    checkTable(table);
    return 0;
}
