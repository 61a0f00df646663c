#pragma once

#include <exception>
#include <string>

namespace VK {

/// Data is missing on the host.
class InstrumentationException : public std::exception {
public:
    explicit InstrumentationException(const char* text) : message(text) {}
    InstrumentationException(const InstrumentationException&) = default;
    InstrumentationException& operator=(const InstrumentationException&) = delete;
    ~InstrumentationException() override = default;

    const char* what() const noexcept override { return message.c_str(); }

private:
    std::string message;
};

/// A key that the caller had to give is missing.
class FrameworkException : public std::exception {
public:
    explicit FrameworkException(const char* text) : message(text) {}
    FrameworkException(const FrameworkException&) = default;
    FrameworkException& operator=(const FrameworkException&) = delete;
    ~FrameworkException() override = default;

    const char* what() const noexcept override { return message.c_str(); }

private:
    std::string message;
};

} // namespace VK
