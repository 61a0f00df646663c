#pragma once

#include "tree/TreeText.h"

#include <nlohmann/json.hpp>

#include <cstdint>
#include <string>
#include <unordered_set>

namespace VK::Tree {

/// Takes a JSON parser's events and makes nodes of them. Each event that does not belong where it comes ends the
/// parsing with a problem.
class TreeReader {
public:
    TreeReader(TreeText& fill, const std::size_t& readSoFar) : result(fill), position(readSoFar) {}

    // What the parser calls, under the names that it knows; false ends the parsing.
    bool null();
    bool boolean(bool value);
    bool number_integer(std::int64_t value);
    bool number_unsigned(std::uint64_t value);
    bool number_float(double value, const std::string& text);
    bool string(std::string& text);
    bool binary(nlohmann::json::binary_t& bytes);
    bool start_object(std::size_t size);
    bool key(std::string& name);
    bool end_object();
    bool start_array(std::size_t size);
    bool end_array();
    bool parse_error(std::size_t at, const std::string& lastToken, const nlohmann::json::exception& error);

private:
    enum Where { Outside, Top, Product, AllNodes, OneNode, Properties, Numbers, Done };
    enum Key {
        NodesKey,
        ProductKey,
        ArchitectureKey,
        UidKey,
        RootDirectoryKey,
        KvmKey,
        TypeKey,
        PathKey,
        ParentKey,
        StatusKey,
        DescriptionKey,
        PropertiesKey,
        ReadOnlyKey,
        UnanswerableKey,
        FailWritesKey
    };

    bool refuse(const std::string& what);
    bool misplaced(const std::string& kind);
    bool takeKey(const std::string& name);
    bool takePropertyNumber(const std::string& text);
    bool finishNode();
    std::vector<unsigned int>& numbers();
    bool has(Key one) const { return (seen & (1U << one)) != 0; }

    TreeText& result;
    const std::size_t& position;
    Where where = Outside;
    Key current = NodesKey;
    unsigned int property = 0;
    unsigned int seen = 0;    ///< keys of the object being read, a bit for each
    unsigned int seenTop = 0; ///< those of the outermost object, while another one is read
    Node node;
    std::unordered_set<std::string> paths;
};

} // namespace VK::Tree
