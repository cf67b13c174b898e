/// How values cross the exports of the flat layer, written once: what comes in, what goes out, what a null argument
/// and an exception do. The exports themselves are generated; each names its operation in a small function of no state
/// and hands that to call(), so that an export is a few instructions and all handling lies in one body a signature.
#pragma once

#include <cstdint>
#include <string>
#include <type_traits>

#include "hqf/errors/elmx_error.h"
#include "hqf/flat/platform_strings.h"

namespace hqf::flat {

/// Raises the managed exception for a null argument, if its callback is registered.
void null_argument(const char* message) noexcept;

/// The same as an expression: the default of the export's result.
template<class result>
result null_argument_result(const char* message) noexcept {
    null_argument(message);
    return result();
}

/// For use in a handler: tells row 0 of the exception callbacks the text of the exception in flight.
void report_exception() noexcept;

/// The same, and the code that stands for it: never 0, for the operation has failed.
std::int32_t exception_code() noexcept;

/// The object behind the pointer of an export.
template<class object_type>
object_type& of(void* object) {
    return *static_cast<object_type*>(object);
}

template<class object_type>
const object_type& of(const void* object) {
    return *static_cast<const object_type*>(object);
}

/// The address of an object that a caller may change through other exports.
template<class object_type>
void* address(const object_type& object) {
    return const_cast<object_type*>(&object);
}

/// Ends an object; null is allowed.
template<class object_type>
void destroy(void* object) noexcept {
    delete static_cast<object_type*>(object);
}

template<class base, class derived>
void* upcast(void* object) noexcept {
    return static_cast<base*>(static_cast<derived*>(object));
}

/// A private copy of a class identity, null for null. It is kept until the process ends, because callers may hold what
/// an earlier reading gave.
const char* kept_identity(const char* text);

/// Text that may be null, passed on as it is.
struct nullable_text {
    const char* text;
};

/// How an argument comes in: `from` is the type at the export, `to` gives what the operation takes. The kinds of text
/// that must not be null say so in `checked`.
template<class type>
struct incoming {
    using from = type;
    static constexpr bool checked = false;
    static type to(type value) { return value; }
};

template<>
struct incoming<const std::wstring&> {
    using from = const wchar_t*;
    static constexpr bool checked = false;
    static std::wstring to(const wchar_t* text) { return text == nullptr ? std::wstring() : std::wstring(text); }
};

template<>
struct incoming<const std::string&> {
    using from = const char*;
    static constexpr bool checked = true;
    static std::string to(const char* text) { return text; }
};

template<>
struct incoming<const char*> {
    using from = const char*;
    static constexpr bool checked = true;
    static const char* to(const char* text) { return text; }
};

template<>
struct incoming<nullable_text> {
    using from = const char*;
    static constexpr bool checked = false;
    static nullable_text to(const char* text) { return {text}; }
};

template<>
struct incoming<bool> {
    using from = std::int32_t;
    static constexpr bool checked = false;
    static bool to(std::int32_t value) { return value != 0; }
};

/// How a result goes out, and what stands in its place where the operation failed.
template<class type>
struct outgoing {
    using to = type;
    static type from(type value) { return value; }
    static type failed() noexcept {
        report_exception();
        return type();
    }
};

template<>
struct outgoing<lmx::elmx_error> {
    using to = std::int32_t;
    static std::int32_t from(lmx::elmx_error code) { return code; }
    static std::int32_t failed() noexcept { return exception_code(); }
};

template<>
struct outgoing<void> {
    using to = void;
    static void failed() noexcept { report_exception(); }
};

template<>
struct outgoing<bool> : outgoing<std::int32_t> {};

template<>
struct outgoing<std::wstring> : outgoing<wchar_t*> {
    static wchar_t* from(const std::wstring& text) { return platform_string(text); }
};

template<>
struct outgoing<const std::wstring&> : outgoing<std::wstring> {};

template<>
struct outgoing<std::string> : outgoing<char*> {
    static char* from(const std::string& text) { return platform_string(text); }
};

template<>
struct outgoing<const std::string&> : outgoing<std::string> {};

template<class type>
bool is_refused(typename incoming<type>::from value) noexcept {
    if constexpr (incoming<type>::checked)
        return value == nullptr;
    else
        return false;
}

/// Forwards to an operation. Nothing that it raises crosses: see report_exception() and exception_code().
///
/// The types come from the operation, and are few: objects are `void*` here. Hence one body of this serves all exports
/// of a signature; inlined into each it would be ten times the code.
template<class result, class... arguments>
[[gnu::noinline]] typename outgoing<result>::to call(result (*operation)(arguments...),
                                                     typename incoming<arguments>::from... values) noexcept {
    if ((is_refused<arguments>(values) || ...))
        return null_argument_result<typename outgoing<result>::to>("null string");
    try {
        if constexpr (std::is_void_v<result>)
            operation(incoming<arguments>::to(values)...);
        else
            return outgoing<result>::from(operation(incoming<arguments>::to(values)...));
    } catch (...) {
        return outgoing<result>::failed();
    }
}

} // namespace hqf::flat
