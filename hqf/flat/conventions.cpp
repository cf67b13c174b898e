/// The callback tables, and what reaches them.

#include "hqf/flat/conventions.h"

#include <array>
#include <exception>
#include <forward_list>

#include "hqf/errors/c_lmx_exception.h"
#include "hqf/flat/hqf_flat.h"
#include "hqf/zip/CZipException.h"

namespace {

/// Filled before any other call and only read afterwards, so that nothing guards it.
struct {
    std::array<hqf_exception_callback, 11> exceptions{};
    std::array<hqf_argument_callback, 3> arguments{};
    hqf_string_callback string = nullptr;
} callbacks;

constexpr std::size_t general_exception = 0;
constexpr std::size_t argument_null = 1;

void tell(const char* message) noexcept {
    if (callbacks.exceptions[general_exception] != nullptr) callbacks.exceptions[general_exception](message);
}

} // namespace

namespace hqf::flat {

void null_argument(const char* message) noexcept {
    if (callbacks.arguments[argument_null] != nullptr) callbacks.arguments[argument_null](message, nullptr);
}

void report_exception() noexcept {
    try {
        throw;
    } catch (const std::exception& exception) {
        tell(exception.what());
    } catch (const lmx::c_lmx_exception& exception) {
        tell(exception.what());
    } catch (...) {
        tell("unknown exception");
    }
}

std::int32_t exception_code() noexcept {
    report_exception();
    try {
        throw;
    } catch (const CZipException&) {
        return lmx::err_user_defined_error_1;
    } catch (...) {
        return lmx::err_undefined_error;
    }
}

const char* kept_identity(const char* text) {
    if (text == nullptr) return nullptr;
    static auto* const kept = new std::forward_list<std::string>; // never deleted: others' destructors may read it
    return kept->emplace_front(text).c_str();
}

} // namespace hqf::flat

void SWIGRegisterExceptionCallbacks_HqfModule(hqf_exception_callback row_0, hqf_exception_callback row_1,
                                              hqf_exception_callback row_2, hqf_exception_callback row_3,
                                              hqf_exception_callback row_4, hqf_exception_callback row_5,
                                              hqf_exception_callback row_6, hqf_exception_callback row_7,
                                              hqf_exception_callback row_8, hqf_exception_callback row_9,
                                              hqf_exception_callback row_10) {
    callbacks.exceptions = {row_0, row_1, row_2, row_3, row_4, row_5, row_6, row_7, row_8, row_9, row_10};
}

void SWIGRegisterExceptionArgumentCallbacks_HqfModule(hqf_argument_callback row_0, hqf_argument_callback row_1,
                                                      hqf_argument_callback row_2) {
    callbacks.arguments = {row_0, row_1, row_2};
}

void SWIGRegisterStringCallback_HqfModule(hqf_string_callback callback) {
    callbacks.string = callback;
}
