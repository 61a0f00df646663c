#include "tree/TreeText.h"

#include "tree/TreeReader.h"

#include <nlohmann/json.hpp>

#include <iterator>

namespace VK::Tree {

namespace {

/// Tells how far the parser has read.
class CountingIterator {
public:
    using iterator_category = std::input_iterator_tag;
    using value_type = char;
    using difference_type = std::ptrdiff_t;
    using pointer = const char*;
    using reference = const char&;

    CountingIterator(const char* at, std::size_t& readSoFar) : place(at), count(&readSoFar) {}
    reference operator*() const { return *place; }
    CountingIterator& operator++() {
        ++place;
        ++*count;
        return *this;
    }
    friend bool operator==(const CountingIterator& a, const CountingIterator& b) { return a.place == b.place; }
    friend bool operator!=(const CountingIterator& a, const CountingIterator& b) { return !(a == b); }

private:
    const char* place;
    std::size_t* count;
};

using OrderedJson = nlohmann::ordered_json;

OrderedJson* findNode(OrderedJson& document, const std::string& path) {
    for (OrderedJson& node : document["nodes"])
        if (node["path"] == path) return &node;
    return nullptr;
}

} // namespace

bool hasZeroByte(const std::string& text) {
    return text.find('\0') != std::string::npos;
}

TreeText readTreeText(std::string_view text) {
    TreeText result;
    std::size_t readSoFar = 0;
    TreeReader reader(result, readSoFar);
    nlohmann::json::sax_parse(CountingIterator(text.data(), readSoFar),
                              CountingIterator(text.data() + text.size(), readSoFar), &reader);
    if (!result.problem.empty()) {
        result.nodes.clear();
        result.product = {};
    }
    return result;
}

std::string changeTreeText(std::string_view text, const std::string& path, unsigned int property, const Value& value) {
    if (const auto* content = std::get_if<std::string>(&value); content != nullptr && hasZeroByte(*content)) return {};
    OrderedJson document = OrderedJson::parse(text, nullptr, false);
    if (document.is_discarded()) return {};
    OrderedJson* node = findNode(document, path);
    if (node == nullptr) return {};
    OrderedJson& place = (*node)["properties"][std::to_string(property)];
    std::visit([&place](const auto& content) { place = content; }, value);
    try {
        return document.dump(2) + "\n";
    } catch (const OrderedJson::type_error&) { // a text that is not UTF-8
        return {};
    }
}

} // namespace VK::Tree
