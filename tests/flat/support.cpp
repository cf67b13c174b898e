#include "support.h"

#include <ostream>
#include <utility>

namespace flat_test {

namespace {

std::vector<told> messages;

template<int row>
void on_exception(const char* message) {
    messages.push_back({"exception", row, message});
}

template<int row>
void on_argument(const char* message, const char* parameter_name) {
    messages.push_back({"argument", row, message, parameter_name != nullptr});
}

void* on_string(const char*) {
    messages.push_back({"string", 0, "called"});
    return nullptr;
}

} // namespace

void PrintTo(const told& call, std::ostream* out) {
    *out << call.table << " row " << call.row << ": " << call.message;
}

listener::listener() {
    messages.clear();
    SWIGRegisterExceptionCallbacks_HqfModule(on_exception<0>, on_exception<1>, on_exception<2>, on_exception<3>,
                                             on_exception<4>, on_exception<5>, on_exception<6>, on_exception<7>,
                                             on_exception<8>, on_exception<9>, on_exception<10>);
    SWIGRegisterExceptionArgumentCallbacks_HqfModule(on_argument<0>, on_argument<1>, on_argument<2>);
    SWIGRegisterStringCallback_HqfModule(on_string);
}

listener::~listener() {
    SWIGRegisterExceptionCallbacks_HqfModule(nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr,
                                             nullptr, nullptr, nullptr);
    SWIGRegisterExceptionArgumentCallbacks_HqfModule(nullptr, nullptr, nullptr);
    SWIGRegisterStringCallback_HqfModule(nullptr);
}

std::vector<told> listener::heard() {
    return std::exchange(messages, {});
}

std::wstring taken(wchar_t* text) {
    if (text == nullptr) return L"(null)";
    const std::wstring result(text, SysStringLen(text));
    const bool is_closed = text[result.size()] == L'\0';
    SysFreeString(text);
    return is_closed ? result : L"(no NUL)";
}

std::string taken(char* text) {
    if (text == nullptr) return "(null)";
    const std::string result(text, SysStringByteLen(text));
    const bool is_closed = text[result.size()] == '\0';
    SysFreeString(text);
    return is_closed ? result : "(no NUL)";
}

} // namespace flat_test
