#pragma once

// Function tables whose every slot notes which one it is and what it was called with.

#include "Layout.h"

#include <cmpift.h>

#include <cstdint>
#include <type_traits>
#include <vector>

namespace fake {

struct Call {
    const void* slot = nullptr; // where in its fake table
    std::vector<std::uintptr_t> arguments;
};

inline Call lastCall;

template <class Table>
Table table{};

template <class T>
std::uintptr_t word(T value) {
    if constexpr (std::is_pointer_v<T>) {
        return reinterpret_cast<std::uintptr_t>(value);
    } else {
        return static_cast<std::uintptr_t>(value);
    }
}

// What a fake slot answers; never the zero that an empty one would give.
template <class T>
T answer() {
    if constexpr (std::is_pointer_v<T>) {
        return reinterpret_cast<T>(std::uintptr_t{0x5A50});
    } else {
        return static_cast<T>(1);
    }
}
template <>
inline CMPIStatus answer() {
    return {CMPI_RC_ERR_NOT_FOUND, answer<CMPIString*>()};
}
template <>
inline CMPIData answer() {
    CMPIData data{CMPI_uint64, CMPI_keyValue, {}};
    data.value.uint64 = 0x5A5A5A5A5A5A5A5A;
    return data;
}
template <>
inline void answer() {}

template <class T>
bool isAnswer(const T& result) {
    return result == answer<T>();
}
inline bool isAnswer(const CMPIStatus& result) {
    return result.rc == answer<CMPIStatus>().rc && result.msg == answer<CMPIStatus>().msg;
}
inline bool isAnswer(const CMPIData& result) {
    const CMPIData expected = answer<CMPIData>();
    return result.type == expected.type && result.state == expected.state &&
           result.value.uint64 == expected.value.uint64;
}

template <auto member, class Table, class Result, class... Arguments>
void install(Result (*Table::*)(Arguments...)) {
    table<Table>.*member = [](Arguments... arguments) -> Result {
        lastCall = {&(table<Table>.*member), {word(arguments)...}};
        return answer<Result>();
    };
}
// What is no slot stays as it is.
template <auto member, class Table, class Data>
void install(Data Table::*) {}

inline void installAll() {
#define STRUCT(type, size, alignment)
#define FIELD(type, member, offset, size) install<&type::member>(&type::member);
#include "LayoutOfBroker.inc"
#include "LayoutOfObjects.inc"
#undef STRUCT
#undef FIELD
}

// A value of its own for each number: an object with a fake table, an address or a small number.
template <class T, int number>
struct Distinct {
    static T make() {
        if constexpr (std::is_pointer_v<T>) {
            return reinterpret_cast<T>(std::uintptr_t{0x1000} * (number + 1));
        } else {
            // Few enough for the smallest enumeration.
            return static_cast<T>(std::is_enum_v<T> ? number % 2 + 1 : number % 100 + 1);
        }
    }
};
template <int number>
struct Distinct<const CMPIBroker*, number> {
    static const CMPIBroker* make() {
        static CMPIBroker broker = {&broker, &table<CMPIBrokerFT>, &table<CMPIBrokerEncFT>, &table<CMPIBrokerExtFT>,
                                    &table<CMPIBrokerMemFT>};
        return &broker;
    }
};
#define FAKE_OBJECT(name)                                                                                              \
    template <int number>                                                                                              \
    struct Distinct<CMPI##name*, number> {                                                                             \
        static CMPI##name* make() {                                                                                    \
            static CMPI##name object = {&object, &table<CMPI##name##FT>};                                              \
            return &object;                                                                                            \
        }                                                                                                              \
    };                                                                                                                 \
    template <int number>                                                                                              \
    struct Distinct<const CMPI##name*, number> : Distinct<CMPI##name*, number> {};
FAKE_OBJECT(Context)
FAKE_OBJECT(Result)
FAKE_OBJECT(ObjectPath)
FAKE_OBJECT(Instance)
FAKE_OBJECT(Args)
FAKE_OBJECT(String)
FAKE_OBJECT(Array)
FAKE_OBJECT(Enumeration)
FAKE_OBJECT(DateTime)
FAKE_OBJECT(SelectExp)
FAKE_OBJECT(SelectCond)
FAKE_OBJECT(SubCond)
FAKE_OBJECT(Predicate)
FAKE_OBJECT(Error)
#undef FAKE_OBJECT

} // namespace fake
