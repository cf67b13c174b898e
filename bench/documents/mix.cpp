/// Everything: palettes, colour sets and loose colours with all that can stand in them, each colour in three of the 27
/// forms, and a quality-control record for every tenth colour.

#include "bench/documents/documents.h"
#include "bench/documents/mix_conditions.h"
#include "bench/documents/mix_forms.h"

namespace hqf_bench {

namespace {

void add_owner(hqf_v2::OwnerType& owner, random_values& values) {
    ok(owner.append_Person());
    ok(owner.back_Person().set_Name(wide("Zoë Müller")));
    ok(owner.back_Person().set_ContactInfo(L"zoe@example.org"));
    ok(owner.append_Copyright(varied_text(values)));
    ok(owner.append_Company(L"Example Colours & Sons"));
}

template<class substrate>
substrate& with_part_number(substrate& chosen) {
    ok(chosen.set_PartNumber(L"S-12"));
    return chosen;
}

void add_substrate(hqf_v2::sg_Substrate& substrate, random_values& values) {
    switch (values.below(9)) {
    case 0: ok(with_part_number(substrate.get_SubstratePaper()).set_PaperThickness(0.12)); break;
    case 1: ok(with_part_number(substrate.get_SubstrateGeneric()).set_Type(varied_text(values))); break;
    case 2: ok(with_part_number(substrate.get_SubstrateMetal()).set_MetalType(L"Aluminium")); break;
    case 3: ok(substrate.get_SubstratePlastic().set_PlasticType(L"ABS")); break;
    case 4: ok(substrate.get_SubstrateWood().set_WoodType(L"Oak")); break;
    case 5: ok(substrate.get_SubstrateVinyl().set_VinylWeight(values.measured(0, 3))); break;
    case 6: ok(substrate.get_SubstrateTile().set_TileType(L"Glazed")); break;
    case 7: ok(substrate.get_SubstrateFilm().set_FilmWeight(values.measured(0, 3))); break;
    default: ok(substrate.get_SubstrateTextile().set_TextileType(L"Linen"));
    }
}

class mix final : public author {
public:
    void add_to(hqf_v2::Hqf& document) override {
        if (number_ == 0) add_revision(document);
        if (number_ % 60 == 0) add_palette(document);
        auto& palette = document.back_Palette();
        if (number_ % 20 == 0) add_set(palette);
        if (number_ % 10 == 9) {
            ok(document.append_Color());
            fill(document.back_Color());
            records_->add_to(document);
        } else {
            ok(palette.back_ColorSet().append_Color());
            fill(palette.back_ColorSet().back_Color());
        }
        ++number_;
    }

private:
    static void add_revision(hqf_v2::Hqf& document) {
        auto& header = document.get_Preamble().get_Header();
        ok(header.append_Revision());
        ok(header.back_Revision().append_any("<n:note xmlns:n=\"urn:example:note\" n:kind=\"first\">kept <n:b>as "
                                             "it</n:b> stands &amp; &#233;</n:note>"));
        ok(header.get_WritePlatformInformation().set_OperatingSystem(L"Debian GNU/Linux"));
        ok(header.get_WritePlatformInformation().set_OperatingSystemVersion(L"12"));
    }

    void add_palette(hqf_v2::Hqf& document) {
        ok(document.append_Palette());
        auto& palette = document.back_Palette();
        ok(palette.set_PaletteName(varied_text(values_)));
        ok(palette.set_PalettePartNumber(L"PP-" + std::to_wstring(number_)));
        ok(palette.set_PaletteVersion(L"1.0"));
        ok(palette.set_UniqueID(L"palette-" + std::to_wstring(number_)));
        ok(palette.set_Comments(varied_text(values_)));
        add_custom_attribute(palette, "Rows", 4);
        add_custom_attribute(palette, "Step", 2.5);
        ok(palette.append_ChangeHistory(date(number_)));
        add_owner(palette.get_Owner(), values_);
        ok(palette.append_SemanticAssociation(varied_text(values_)));
        vary(palette.get_CollectionColorSpaceSpecification(), values_);
    }

    void add_set(hqf_v2::PaletteType& palette) {
        ok(palette.append_ColorSet());
        auto& set = palette.back_ColorSet();
        ok(set.set_ColorSetName(varied_text(values_)));
        ok(set.set_PartNumber(L"Row " + std::to_wstring(number_)));
        ok(set.append_ChangeHistory(date(number_)));
        ok(set.append_SemanticAssociation(varied_text(values_)));
        add_substrate(set.get_Substrate(), values_);
    }

    void fill(hqf_v2::ColorType& color) {
        ok(color.set_ColorName(colour_name(number_)));
        ok(color.set_UniqueID(L"color-" + std::to_wstring(number_)));
        ok(color.set_ColorNumber(std::to_wstring(number_)));
        if (values_.one_in(4)) ok(color.set_Comments(varied_text(values_)));
        if (values_.one_in(3)) add_custom_attribute(color, "Position", "A1");
        ok(color.append_ChangeHistory(date(number_)));
        if (values_.one_in(6)) add_owner(color.get_Owner(), values_);
        if (values_.one_in(3)) ok(color.append_SemanticAssociation(varied_text(values_)));
        for (unsigned int i = 0; i < 3; ++i) {
            ok(color.append_ColorSpace());
            fill_form(color.back_ColorSpace(), next_form_++ % form_count, values_);
        }
        if (values_.one_in(3)) add_substrate(color.get_Substrate(), values_);
    }

    random_values values_{4};
    unsigned int number_ = 0;
    unsigned int next_form_ = 0;
    std::unique_ptr<author> records_ = quality_control_author();
};

} // namespace

std::unique_ptr<author> mix_author() {
    return std::make_unique<mix>();
}

} // namespace hqf_bench
