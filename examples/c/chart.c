/// The library's main job from C: loads the measured colours of a rendition chart, prints them, adds a colour, writes
/// the document plain and as an archive, and loads both again.
///
/// usage: chart CHART.hqf NEW          writes NEW.hqf and NEW.hqfz

#include <hqf/flat/hqf_flat.h>

#include <locale.h>
#include <stdio.h>
#include <stdlib.h>

/// Every function below stops here when a code isn't 0. Objects are not freed then: the process ends.
static void must(int32_t code, const char* what) {
    if (code == 0) return;
    fprintf(stderr, "%s: %s (%d)\n", what, CSharp_get_error_description(code), (int)code);
    exit(1);
}

static void on_exception(const char* message) {
    fprintf(stderr, "an operation raised %s\n", message);
}

static void on_null_argument(const char* message, const char* parameter_name) {
    (void)parameter_name; // always null
    fprintf(stderr, "%s\n", message);
}

/// Prints text that an export gave, as UTF-8, and frees it.
static void print_text(wchar_t* text) {
    const uint32_t size = SysStringLen(text);
    for (uint32_t i = 0; i < size; ++i) {
        unsigned long c = (unsigned long)text[i];
        if (c >= 0xD800 && c < 0xDC00 && i + 1 < size) // the first of two units that make one character
            c = 0x10000 + ((c - 0xD800) << 10) + ((unsigned long)text[++i] - 0xDC00);
        if (c < 0x80)
            putchar((int)c);
        else if (c < 0x800)
            printf("%c%c", (int)(0xC0 | c >> 6), (int)(0x80 | (c & 63)));
        else if (c < 0x10000)
            printf("%c%c%c", (int)(0xE0 | c >> 12), (int)(0x80 | (c >> 6 & 63)), (int)(0x80 | (c & 63)));
        else
            printf("%c%c%c%c", (int)(0xF0 | (c >> 18 & 7)), (int)(0x80 | (c >> 12 & 63)), (int)(0x80 | (c >> 6 & 63)),
                   (int)(0x80 | (c & 63)));
    }
    SysFreeString(text);
}

/// A path of the command line with a suffix, for exports that take wide paths.
static const wchar_t* wide_path(wchar_t* out, size_t size, const char* path, const char* suffix) {
    char joined[1000];
    const int length = snprintf(joined, sizeof joined, "%s%s", path, suffix);
    const size_t written = mbstowcs(out, joined, size);
    if (length >= (int)sizeof joined || written >= size) {
        fprintf(stderr, "%s: a path that is too long, or not in the locale's encoding\n", path);
        exit(1);
    }
    return out;
}

static hqf_Hqf* loaded(const wchar_t* path) {
    hqf_Hqf* document = CSharp_new_Hqf__SWIG_0();
    must(CSharp_Hqf_loadFile(document, path), "loading");
    return document;
}

static void print_color(hqf_ColorType* color) {
    print_text(CSharp_ColorType_get_ColorNumber(color));
    printf("  ");
    print_text(CSharp_ColorType_get_ColorName(color));
    for (uint32_t i = 0; i < CSharp_ColorType_size_ColorSpace(color); ++i) {
        hqf_sg_ColorSpace* form = CSharp_ColorType_get_ColorSpace__SWIG_0(color, i);
        // Asking for a member that isn't chosen would choose it.
        if (CSharp_sg_ColorSpace_getchosen(form) != hqf_sg_ColorSpace_chosen_ColorSpaceCIELab) continue;
        hqf_ColorSpaceCIELabType* lab = CSharp_sg_ColorSpace_get_ColorSpaceCIELab__SWIG_0(form);
        printf("  %.2f %.2f %.2f", CSharp_ColorSpaceCIELabType_get_L(lab), CSharp_ColorSpaceCIELabType_get_A(lab),
               CSharp_ColorSpaceCIELabType_get_B(lab));
    }
    putchar('\n');
}

static void print_palette(hqf_PaletteType* palette) {
    for (uint32_t s = 0; s < CSharp_PaletteType_size_ColorSet(palette); ++s) {
        hqf_ColorSetType* set = CSharp_PaletteType_get_ColorSet__SWIG_0(palette, s);
        print_text(CSharp_ColorSetType_get_ColorSetName(set));
        putchar('\n');
        for (uint32_t i = 0; i < CSharp_ColorSetType_size_Color(set); ++i)
            print_color(CSharp_ColorSetType_get_Color__SWIG_0(set, i));
    }
}

/// Adds a colour with its CIELAB values. The conditions of measurement are nil, because the palette states them for
/// all.
static void add_leaf(hqf_ColorSetType* set) {
    lmx_c_datetime* when = CSharp_new_c_datetime__SWIG_1("2025-01-31T12:00:00Z");
    must(CSharp_ColorSetType_append_Color(set), "adding a colour");
    hqf_ColorType* leaf = CSharp_ColorSetType_back_Color(set);
    must(CSharp_ColorType_set_ColorName(leaf, L"Olive green leaf"), "its name");
    must(CSharp_ColorType_set_ColorNumber(leaf, L"25"), "its number");
    must(CSharp_ColorType_append_ChangeHistory(leaf, when), "its date");

    must(CSharp_ColorType_append_ColorSpace(leaf), "its values");
    hqf_sg_ColorSpace* form = CSharp_ColorType_back_ColorSpace(leaf);
    hqf_ColorSpaceCIELabType* lab = CSharp_sg_ColorSpace_get_ColorSpaceCIELab__SWIG_0(form);
    // What every form has is reached through its base.
    hqf_ColorSpaceType* base = CSharp_ColorSpaceCIELabTypeUpcast(lab);
    must(CSharp_ColorSpaceType_append_ChangeHistory(base, when), "their date");
    hqf_ColorSpaceSpecificationSpectrumTristimulus* conditions =
        CSharp_ColorSpaceCIELabType_get_ColorSpaceSpecificationSpectrumTristimulus__SWIG_0(lab);
    CSharp_ColorSpaceSpecificationSpectrumTristimulus_setnil_ColorSpaceSpecificationSpectrumTristimulus(conditions);
    must(CSharp_ColorSpaceCIELabType_set_L(lab, 40.79), "L*");
    must(CSharp_ColorSpaceCIELabType_set_A(lab, -12.39), "a*");
    must(CSharp_ColorSpaceCIELabType_set_B(lab, 24.06), "b*");
    printf("L* of 151 is refused: %s\n", CSharp_get_error_description(CSharp_ColorSpaceCIELabType_set_L(lab, 151)));
    CSharp_delete_c_datetime(when); // the lists hold copies
}

static void write_and_compare(hqf_Hqf* document, const char* name, const char* suffix) {
    wchar_t path[1000];
    wide_path(path, 1000, name, suffix);
    must(CSharp_Hqf_writeFile(document, path), "writing");
    hqf_Hqf* again = loaded(path);
    printf("%s%s: %s\n", name, suffix, hqf_Hqf_equal(document, again) ? "the same again" : "CHANGED");
    CSharp_delete_Hqf(again);
}

int main(int argc, char** argv) {
    if (argc != 3) {
        fprintf(stderr, "usage: %s CHART.hqf NEW\n", argv[0]);
        return 2;
    }
    setlocale(LC_CTYPE, ""); // the encoding of the command line
    SWIGRegisterExceptionCallbacks_HqfModule(on_exception, NULL, NULL, NULL, NULL, NULL, NULL, NULL, NULL, NULL, NULL);
    SWIGRegisterExceptionArgumentCallbacks_HqfModule(NULL, on_null_argument, NULL);

    wchar_t path[1000];
    hqf_Hqf* document = loaded(wide_path(path, 1000, argv[1], ""));
    hqf_PaletteType* palette = CSharp_Hqf_get_Palette__SWIG_0(document, 0);
    hqf_ColorSetType* natural_colours = CSharp_PaletteType_get_ColorSet__SWIG_0(palette, 0);
    add_leaf(natural_colours);
    print_palette(palette);

    // The archive first: it is packed from the plain file of its name, which goes away with that.
    write_and_compare(document, argv[2], ".hqfz");
    write_and_compare(document, argv[2], ".hqf");
    CSharp_delete_Hqf(document);
    return 0;
}
