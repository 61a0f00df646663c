#pragma once

#include <string>

namespace VK::BaseServerProvider {

/// The iterator of a class that has exactly one element: it stands on it at first, and is past it after one `++`.
class SingleElement {
public:
    enum class FilterType : unsigned int {};

    SingleElement(const SingleElement&) = delete;
    SingleElement& operator=(const SingleElement&) = delete;

    /// There is nothing to choose from: does nothing.
    void setFilter(FilterType, const std::string&) {}

    explicit operator bool() const { return position == 0; }
    SingleElement& operator++() {
        ++position;
        return *this;
    }

protected:
    SingleElement() = default;
    ~SingleElement() = default;

private:
    unsigned short position = 0;
};

} // namespace VK::BaseServerProvider
