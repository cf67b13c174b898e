// What the callbacks of the flat layer were told, and what it gives, taken over and freed.
#pragma once

#include <ostream>
#include <string>
#include <utility>
#include <vector>

#include "hqf/flat/hqf_flat.h"

namespace flat_test {

/// A call of a callback: the table, the row in it and the message.
struct told {
    std::string table;
    int row;
    std::string message;
    bool has_parameter_name = false;
    friend bool operator==(const told&, const told&) = default;
    friend void PrintTo(const told& call, std::ostream* out) {
        *out << call.table << " row " << call.row << ": " << call.message;
    }
};
using calls = std::vector<told>;
inline calls messages;

/// Registers a callback for every row, for as long as it lives, and collects what they are told.
class listener {
public:
    listener() {
        messages.clear();
        SWIGRegisterExceptionCallbacks_HqfModule(raise<0>, raise<1>, raise<2>, raise<3>, raise<4>, raise<5>, raise<6>,
                                                 raise<7>, raise<8>, raise<9>, raise<10>);
        SWIGRegisterExceptionArgumentCallbacks_HqfModule(refuse<0>, refuse<1>, refuse<2>);
        SWIGRegisterStringCallback_HqfModule([](const char*) -> void* {
            messages.push_back({"string", 0, "called"});
            return nullptr;
        });
    }
    ~listener() {
        SWIGRegisterExceptionCallbacks_HqfModule(nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr,
                                                 nullptr, nullptr, nullptr);
        SWIGRegisterExceptionArgumentCallbacks_HqfModule(nullptr, nullptr, nullptr);
        SWIGRegisterStringCallback_HqfModule(nullptr);
    }
    listener(const listener&) = delete;
    listener& operator=(const listener&) = delete;
    /// What came since the last call of this.
    calls heard() { return std::exchange(messages, {}); }

private:
    template<int row>
    static void raise(const char* message) {
        messages.push_back({"exception", row, message});
    }
    template<int row>
    static void refuse(const char* message, const char* parameter_name) {
        messages.push_back({"argument", row, message, parameter_name != nullptr});
    }
};

inline calls nothing() {
    return {};
}
inline calls null_of(const std::string& message) {
    return {{"argument", 1, message}};
}
inline calls raised(const std::string& message) {
    return {{"exception", 0, message}};
}

/// An object that an export gave, deleted by the export of its class.
template<class T>
class own {
public:
    own(T* object, void (*end)(T*))
        : object_(object)
        , end_(end) {}
    ~own() { end_(object_); }
    own(const own&) = delete;
    own& operator=(const own&) = delete;
    operator T*() const { return object_; }
    T* get() const { return object_; }

private:
    T* object_;
    void (*end_)(T*);
};
#define MAKE(cls) own<hqf_##cls>(CSharp_new_##cls##__SWIG_0(), CSharp_delete_##cls)
#define MAKE_VALUE(cls, form, ...) own<lmx_##cls>(CSharp_new_##cls##__SWIG_##form(__VA_ARGS__), CSharp_delete_##cls)

/// The text of a platform string, which is freed. A null one and one without its NUL say so.
template<class unit>
std::basic_string<unit> taken(unit* text) {
    const auto say = [](std::string what) { return std::basic_string<unit>(what.begin(), what.end()); };
    if (text == nullptr) return say("(null)");
    const std::basic_string<unit> result(text, SysStringByteLen(text) / sizeof(unit));
    const bool is_closed = text[result.size()] == 0;
    SysFreeString(text);
    return is_closed ? result : say("(no NUL)");
}

} // namespace flat_test
