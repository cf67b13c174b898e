/* Compiles as C11 without a warning, and links: that is the test. A call of each kind of value stands in it. */
#include "hqf/flat/hqf_flat.h"

#include <stddef.h>

static void on_null(const char* message, const char* parameter_name) {
    (void)message;
    (void)parameter_name;
}

int main(void) {
    SWIGRegisterExceptionArgumentCallbacks_HqfModule(NULL, on_null, NULL);
    hqf_Hqf* document = CSharp_new_Hqf__SWIG_0();
    hqf_Header* header = CSharp_Preamble_get_Header__SWIG_0(CSharp_Hqf_get_Preamble__SWIG_0(document));
    int32_t code = CSharp_Header_set_Creator(header, L"C");
    wchar_t* creator = CSharp_Header_get_Creator(header);
    code += SysStringLen(creator) == 1 ? 0 : 1;
    SysFreeString(creator);
    bool overflow = true;
    lmx_c_big_int* number = CSharp_new_c_big_int__SWIG_2("12");
    code += CSharp_c_big_int_get(number, &overflow) == 12 && !overflow ? 0 : 1;
    CSharp_delete_c_big_int(number);
    code += CSharp_length(NULL) == 0 ? 0 : 1;
    CSharp_delete_Hqf(document);
    return (int)code;
}
