#pragma once

#include "include/MessageBuffer.h"

#include <atomic>
#include <string>

namespace VK {

/// The string in which a line with values is handed over. Its memory comes from earlier lines of any thread: a line
/// allocates nothing, and a thread that serves one request pays for nothing of its own.
class LineText {
public:
    LineText();
    LineText(const LineText&) = delete;
    LineText& operator=(const LineText&) = delete;

    std::string* operator->() const { return text; }
    const std::string& operator*() const { return *text; }

private:
    /// Gives a string for all back; null where none was free.
    struct Taken {
        Taken() = default;
        Taken(const Taken&) = delete;
        Taken& operator=(const Taken&) = delete;
        ~Taken() {
            if (flag != nullptr) flag->store(false, std::memory_order_release);
        }
        std::atomic<bool>* flag = nullptr;
    };

    Taken taken;
    std::string own;
    std::string* text = &own;
};

} // namespace VK
