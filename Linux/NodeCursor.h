#pragma once

#include "include/Trace.h"
#include "vk/Instrumentation.h"

#include <string>
#include <utility>
#include <vector>

namespace VK::BaseServerProvider {

/// The pattern of every data class that stands for nodes of the instrumentation tree: a cursor over the nodes of one
/// type that pass a list of filters.
///
/// `Self` says its node type (`nodeType`), whose trace lines it writes (`traceSource()`) and what each filter compares
/// (`passes(const Filter&)`), and whether a step asks evaluate() also without a filter (`evaluatesUnfiltered`).
/// `FilterTypes` is its enumeration of filters. Filters only narrow what lies ahead: the current node is never rewound,
/// except by initialize().
template <class Self, class FilterTypes>
class NodeCursor {
public:
    using FilterType = FilterTypes;

    struct Filter {
        FilterType type;
        std::string reference; ///< what the node's value must equal
    };

    NodeCursor(const NodeCursor&) = delete;
    NodeCursor& operator=(const NodeCursor&) = delete;

    /// Drops all filters and starts again at the first node.
    void initialize() {
        const TraceScope scope(VK_SCOPE(Self::traceSource()));
        selectFirst();
        filters.clear();
    }

    /// Adds a filter and moves on to the first node, from the current one on, that passes all of them.
    void setFilter(FilterType filterType, std::string reference) {
        const ParameterTraceScope scope(VK_SCOPE(Self::traceSource()), " filterType=", unsigned(filterType),
                                        " reference=", reference.c_str());
        filters.push_back({filterType, std::move(reference)});
        skipFiltered();
    }

    /// Whether the current node passes every filter.
    bool evaluate() const {
        const TraceScope scope(VK_SCOPE(Self::traceSource()));
        for (const Filter& filter : filters)
            if (!static_cast<const Self&>(*this).passes(filter)) return false;
        return true;
    }

    /// Whether there is a current node.
    explicit operator bool() const {
        const TraceScope scope(VK_SCOPE(Self::traceSource()));
        return static_cast<bool>(instrumentation);
    }

    /// Moves to the next node that passes.
    NodeCursor& operator++() {
        const TraceScope scope(VK_SCOPE(Self::traceSource()));
        ++instrumentation;
        if (Self::evaluatesUnfiltered || !filters.empty()) skipFiltered();
        return *this;
    }

protected:
    NodeCursor() = default;
    ~NodeCursor() = default;

    /// Stands on the first node; for the constructor, whose entry line comes before.
    void selectFirst() { instrumentation.selectNode(Self::nodeType); }

    const Instrumentation& node() const { return instrumentation; }

private:
    void skipFiltered() {
        while (instrumentation && !evaluate()) ++instrumentation;
    }

    std::vector<Filter> filters;
    Instrumentation instrumentation;
};

} // namespace VK::BaseServerProvider
