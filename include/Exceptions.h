#pragma once

#include <exception>
#include <string>

namespace VK {

/// What both exceptions of the provider are: a text.
class TextException : public std::exception {
public:
    explicit TextException(const char* text) : message(text) {}
    TextException(const TextException&) = default;
    TextException& operator=(const TextException&) = delete;
    ~TextException() override = default;

    const char* what() const noexcept override { return message.c_str(); }

private:
    std::string message;
};

/// Data is missing on the host.
class InstrumentationException : public TextException {
public:
    using TextException::TextException;
};

/// A key that the caller had to give is missing.
class FrameworkException : public TextException {
public:
    using TextException::TextException;
};

} // namespace VK
