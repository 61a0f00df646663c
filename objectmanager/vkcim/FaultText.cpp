#include "objectmanager/vkcim/FaultText.h"

#include <fmt/format.h>

#include <charconv>
#include <stdexcept>
#include <string_view>

namespace vkcim {
namespace {

bool takeEnd(std::string_view& text, std::string_view end) {
    if (text.size() < end.size() || text.substr(text.size() - end.size()) != end) return false;
    text.remove_suffix(end.size());
    return true;
}

} // namespace

om::Fault parseFault(const std::string& text) {
    const std::size_t colon = text.find(':');
    const auto kind = om::faultKind(std::string_view(text).substr(0, colon));
    if (!kind) throw std::runtime_error(fmt::format("no broker operation is called '{}'", text.substr(0, colon)));
    om::Fault fault;
    fault.kind = *kind;
    std::string_view number = colon == std::string::npos ? "" : std::string_view(text).substr(colon + 1);
    fault.unstated = takeEnd(number, ":null");
    fault.lasting = takeEnd(number, "+");
    const char* const end = number.data() + number.size();
    const auto [read, error] = std::from_chars(number.data(), end, fault.call);
    if (error != std::errc() || read != end || fault.call == 0)
        throw std::runtime_error(fmt::format("'{}' is not KIND:N with a number from 1 on", text));
    return fault;
}

std::string faultList() {
    return fmt::format("{}", fmt::join(om::faultNames(), "\n"));
}

} // namespace vkcim
