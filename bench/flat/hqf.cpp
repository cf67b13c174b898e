/// What a call costs through the flat layer and through the class: the same operation on the same object.

#include <hqf/flat/hqf_flat.h>

#include "bench/subject.h"

namespace hqf_bench {

namespace {

using hqf_v2::ColorSpaceCIELabType;
using hqf_v2::ColorType;

constexpr wchar_t name[] = L"Olive green leaf, measured again";

/// A class as the flat layer sees it.
hqf_ColorSpaceCIELabType* flat(ColorSpaceCIELabType& lab) {
    return reinterpret_cast<hqf_ColorSpaceCIELabType*>(&lab);
}

hqf_ColorType* flat(ColorType& color) {
    return reinterpret_cast<hqf_ColorType*>(&color);
}

/// One row: `call` on an object that `prepare` has filled.
template<class object_type, class call_type>
void add(const char* row, void (*prepare)(object_type&), call_type call) {
    benchmark::RegisterBenchmark((std::string("call/") + row).c_str(), [prepare, call](benchmark::State& state) {
        object_type object;
        prepare(object);
        for (auto _ : state)
            call(object);
    });
}

void set_lightness(ColorSpaceCIELabType& lab) {
    lab.set_L(37.82);
}

void set_name(ColorType& color) {
    color.set_ColorName(name);
}

} // namespace

void add_flat_calls() {
    add("get_double/class", set_lightness, [](ColorSpaceCIELabType& lab) { benchmark::DoNotOptimize(lab.get_L()); });
    add("get_double/flat", set_lightness,
        [](ColorSpaceCIELabType& lab) { benchmark::DoNotOptimize(CSharp_ColorSpaceCIELabType_get_L(flat(lab))); });
    add("set_double/class", set_lightness,
        [](ColorSpaceCIELabType& lab) { benchmark::DoNotOptimize(lab.set_L(40.79)); });
    add("set_double/flat", set_lightness, [](ColorSpaceCIELabType& lab) {
        benchmark::DoNotOptimize(CSharp_ColorSpaceCIELabType_set_L(flat(lab), 40.79));
    });
    // The class gives a reference; what a caller in C gets is a copy, so the row "copy" is the fair one beside it.
    add("get_string/class", set_name, [](ColorType& color) { benchmark::DoNotOptimize(&color.get_ColorName()); });
    add("get_string/copy", set_name, [](ColorType& color) {
        std::wstring copied(color.get_ColorName());
        benchmark::DoNotOptimize(copied.data());
    });
    add("get_string/flat", set_name, [](ColorType& color) {
        wchar_t* const text = CSharp_ColorType_get_ColorName(flat(color));
        benchmark::DoNotOptimize(text);
        SysFreeString(text);
    });
    add("set_string/class", set_name, [](ColorType& color) { benchmark::DoNotOptimize(color.set_ColorName(name)); });
    add("set_string/flat", set_name,
        [](ColorType& color) { benchmark::DoNotOptimize(CSharp_ColorType_set_ColorName(flat(color), name)); });
}

} // namespace hqf_bench
