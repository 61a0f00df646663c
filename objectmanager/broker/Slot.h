#pragma once

#include "objectmanager/broker/Fault.h"

#include <cmpift.h>

#include <cerrno>
#include <cstring>
#include <cxxabi.h>
#include <type_traits>

namespace om {

/// Thrown inside the broker for misuse; the slot turns it into the function's status.
struct Failure {
    CMPIrc code;
};

constexpr CMPIStatus status(CMPIrc code) {
    return CMPIStatus{code, nullptr};
}

/// Writes a status, which may be null as callers that do not care pass null.
inline void report(CMPIStatus* out, CMPIrc code) {
    if (out != nullptr) *out = status(code);
}

/// The value that stands for none: null, not found, its value cleared.
inline CMPIData noData() {
    CMPIData data;
    std::memset(&data, 0, sizeof data); // all of the union, not its first member alone
    data.state = CMPI_nullValue | CMPI_notFound;
    return data;
}

/// Fills one slot of a function table with the function F of ours; Kind says what a fault of it is called.
///
/// The exact type of a slot differs between versions of the CMPI headers (constness of objects, enumerations for
/// integers); the conversion deduces it, and forwards to F. It is also the boundary that no C++ exception crosses:
/// the status parameter is set to OK before F runs, and every exception ends as a failure status where the slot has
/// one, and as null, 0 or ENOMEM where it returns a value.
template <auto F, FaultKind Kind = FaultKind::None>
class Slot {
public:
    template <class R, class... A>
    using Function = R (*)(A...);

    template <class R, class... A>
    constexpr operator Function<R, A...>() const {
        return &call<R, A...>;
    }

    // A thread's end is caught by a reference to no object, which is how the compiler's runtime has it.
    template <class R, class... A>
    __attribute__((no_sanitize("null"))) static R call(A... arguments) {
        CMPIStatus* out = nullptr;
        (pick(out, arguments), ...);
        report(out, CMPI_RC_OK);
        CMPIrc code = CMPI_RC_ERR_FAILED;
        if constexpr (Kind != FaultKind::None) {
            CallWatch* const watch = CallWatch::current();
            if (watch != nullptr && watch->fails(Kind)) {
                if (!watch->unstated()) report(out, code);
                return failed<R>(code);
            }
        }
        try {
            if constexpr (std::is_void_v<R>) {
                F(arguments...);
                return;
            } else {
                return static_cast<R>(F(arguments...));
            }
        } catch (const Failure& failure) {
            code = failure.code;
        } catch (const abi::__forced_unwind&) {
            throw; // the thread is being ended
        } catch (...) {
        }
        report(out, code);
        return failed<R>(code);
    }

private:
    template <class T>
    static void pick(CMPIStatus*& out, T argument) {
        if constexpr (std::is_same_v<T, CMPIStatus*>) out = argument;
    }

    template <class R>
    static R failed([[maybe_unused]] CMPIrc code) {
        if constexpr (std::is_same_v<R, CMPIStatus>) {
            return status(code);
        } else if constexpr (std::is_same_v<R, CMPIData>) {
            return noData();
        } else if constexpr (std::is_same_v<R, int>) {
            return ENOMEM; // only the thread functions return an int
        } else if constexpr (!std::is_void_v<R>) {
            return R{};
        }
    }
};

/// A function table with nothing but its version; a version member may be const.
template <class Table>
constexpr Table emptyTable() {
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wmissing-field-initializers"
    return Table{CMPIVersion200};
#pragma GCC diagnostic pop
}

} // namespace om
