#include "hqf/values/ct_qname.h"

#include "hqf/values/text.h"

namespace lmx {

void make_qname(std::string* result, const std::string& first, const std::string&, const std::string&) {
    *result = first;
}

void make_qname(std::wstring* result, const std::string& first, const std::string&, const std::string&) {
    vtostring(*result, first);
}

void make_qname(ct_qname<std::string>* result, const std::string&, const std::string& second,
                const std::string& third) {
    result->text = third;
    result->narrow = second;
}

void make_qname(ct_qname<std::wstring>* result, const std::string&, const std::string& second,
                const std::string& third) {
    vtostring(result->text, third);
    result->narrow = second;
}

} // namespace lmx
