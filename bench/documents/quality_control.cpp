/// Records of 25 patches. In four of five records a patch has a standard, two measurements and their colour
/// differences; in the fifth there is no standard (nil), and the last of three measurements carries the deviations.

#include "bench/documents/documents.h"
#include "bench/documents/parts.h"

namespace hqf_bench {

namespace {

template<class function>
void give(function& what, double result) {
    ok(what.set_Result(result));
}

class quality_control final : public author {
public:
    void add_to(hqf_v2::Hqf& document) override {
        if (number_ % 25 == 0) add_record(document);
        auto& record = document.back_ColorQualityControl();
        ok(record.append_StandardAndMeasurement());
        auto& patch = record.back_StandardAndMeasurement();
        if (has_standard()) {
            measure_against_standard(patch);
        } else {
            measure_spread(patch);
        }
        ++number_;
    }

private:
    bool has_standard() const { return number_ / 25 % 5 != 4; }

    void add_record(hqf_v2::Hqf& document) {
        ok(document.append_ColorQualityControl());
        auto& record = document.back_ColorQualityControl();
        ok(record.set_Name(L"Proof " + std::to_wstring(number_ / 25)));
        ok(record.set_UniqueID(L"qc-" + std::to_wstring(number_ / 25)));
        ok(record.set_Description(L"Control strip patches of two conditions against a third"));
        add_custom_attribute(record, "Patches", 25);
        ok(record.append_ChangeHistory(date(number_)));
        add_sample(record.get_PhysicalSample());
        add_tolerances(record);
    }

    void add_sample(hqf_v2::PhysicalSampleType& physical) {
        if (has_standard()) {
            ok(physical.set_Coating(L"Gloss"));
            ok(physical.get_Process().set_Name(L"Offset"));
            ok(physical.get_Process().set_Thickness(1.2));
            auto& target = physical.get_Sample().get_SampleTarget();
            ok(target.get_Substrate().get_SubstratePaper().set_PaperType(L"Grade 3"));
            ok(target.set_ProductionDate(date(number_)));
            ok(target.set_Target(L"Target_IT8.7/4"));
        } else {
            auto& spot = physical.get_Sample().get_SampleSpot();
            ok(spot.get_Substrate().get_SubstrateGeneric().set_Type(L"Three kinds of coated paper"));
            ok(spot.set_Backing(L"Backing_White"));
            ok(spot.get_Specification().set_SampleWidth(6));
            ok(spot.get_Specification().set_SampleHeight(6));
        }
    }

    void add_tolerances(hqf_v2::ColorQualityControlType& record) {
        if (has_standard()) {
            auto* difference = new hqf_v2::FunctionDE2000Type;
            set_weights(*difference);
            ok(record.append_Tolerance());
            record.back_Tolerance().get_Function().assign_Function(difference); // written with xsi:type
            add_limits(record.back_Tolerance(), L"All patches");
            return;
        }
        ok(record.append_Tolerance());
        give(record.back_Tolerance().get_Function().get_FunctionAverageStdDevL(), values_.decimal(0, 3, 4));
        add_limits(record.back_Tolerance(), L"Spread of L");
        ok(record.append_Tolerance());
        give(record.back_Tolerance().get_Function().get_FunctionAverageStdDevA(), values_.decimal(0, 3, 4));
        add_limits(record.back_Tolerance(), L"Spread of A");
        ok(record.append_Tolerance());
        give(record.back_Tolerance().get_Function().get_FunctionAverageStdDevB(), values_.decimal(0, 3, 4));
        add_limits(record.back_Tolerance(), L"Spread of B");
    }

    void add_limits(hqf_v2::ToleranceType& tolerance, const wchar_t* name) {
        ok(tolerance.set_Name(name));
        ok(tolerance.get_Limits().set_HighTolerance(2.5));
        ok(tolerance.get_Limits().set_LowTolerance(0));
        ok(tolerance.set_PrimaryIlluminant(L"Illuminant_D50"));
        ok(tolerance.set_FieldOfView(L"FieldOfView_2_Degree"));
    }

    template<class function>
    static void set_weights(function& difference) {
        ok(difference.set_Param_l(1));
        ok(difference.set_Param_c(1));
        ok(difference.set_Param_h(1));
    }

    hqf_v2::Measurement& add_measurement(hqf_v2::StandardAndMeasurementType& patch, bool hand_held) {
        ok(patch.append_Measurement());
        auto& measurement = patch.back_Measurement();
        add_custom_attribute(measurement, "Report", hand_held ? "TR 005-2007" : "TR 003-2007");
        describe_device(measurement.get_Device(), hand_held);
        add_lab(measurement.get_Color());
        return measurement;
    }

    void add_lab(hqf_v2::ColorType& color) {
        ok(color.set_ColorName(L"C10 M20 Y" + std::to_wstring(number_ % 100) + L" K0"));
        ok(color.set_ColorNumber(std::to_wstring(number_)));
        ok(color.append_ChangeHistory(date(number_)));
        ok(color.append_ColorSpace());
        auto& lab = color.back_ColorSpace().get_ColorSpaceCIELab();
        ok(lab.append_ChangeHistory(date(number_)));
        auto& conditions = lab.get_ColorSpaceSpecificationSpectrumTristimulus();
        measure_reflectance(conditions, date(number_));
        calculate_tristimulus(conditions, L"Illuminant_D50");
        measure_at_45_degrees(conditions);
        ok(lab.set_L(values_.measured(5, 98)));
        ok(lab.set_A(values_.measured(-80, 80)));
        ok(lab.set_B(values_.measured(-80, 80)));
    }

    double next_difference() { return values_.decimal(0, 6, 4); }

    void measure_against_standard(hqf_v2::StandardAndMeasurementType& patch) {
        for (const bool hand_held : {false, true}) {
            auto& measurement = add_measurement(patch, hand_held);
            ok(measurement.append_Function());
            give(measurement.back_Function().get_FunctionDE(), next_difference());
            ok(measurement.append_Function());
            set_weights(measurement.back_Function().get_FunctionDE94());
            give(measurement.back_Function().get_FunctionDE94(), next_difference());
            ok(measurement.append_Function());
            set_weights(measurement.back_Function().get_FunctionDE2000());
            give(measurement.back_Function().get_FunctionDE2000(), next_difference());
            ok(measurement.append_Function());
            auto& cmc = measurement.back_Function().get_FunctionDECMC();
            give(cmc, next_difference());
            ok(cmc.set_Param_l(2));
            ok(cmc.set_Param_c(1));
        }
        auto& standard = patch.get_Standard();
        describe_device(standard.get_Device(), false);
        add_lab(standard.get_Color());
        ok(standard.append_Tolerance());
        set_weights(standard.back_Tolerance().get_Function().get_FunctionDE2000());
        add_limits(standard.back_Tolerance(), L"Tint");
    }

    void measure_spread(hqf_v2::StandardAndMeasurementType& patch) {
        add_measurement(patch, false);
        add_measurement(patch, false);
        auto& last = add_measurement(patch, false);
        const auto next = [&]() -> hqf_v2::sg_Function& {
            ok(last.append_Function());
            return last.back_Function();
        };
        give(next().get_FunctionMeanDE(), next_difference());
        give(next().get_FunctionStdDevX(), next_difference());
        give(next().get_FunctionStdDevY(), next_difference());
        give(next().get_FunctionStdDevZ(), next_difference());
        give(next().get_FunctionStdDevL(), next_difference());
        give(next().get_FunctionStdDevA(), next_difference());
        give(next().get_FunctionStdDevB(), next_difference());
        give(next().get_FunctionStdDevC(), next_difference());
        give(next().get_FunctionStdDevH(), next_difference());
        auto& generic = next().get_FunctionGeneric();
        give(generic, next_difference());
        ok(generic.set_Name(L"Hue range"));
        ok(generic.append_Parameters());
        ok(generic.back_Parameters().set_Name(L"Count"));
        ok(generic.back_Parameters().get_ValueChoice().set_Double(3));
        ok(generic.append_Parameters());
        ok(generic.back_Parameters().set_Name(L"Unit"));
        ok(generic.back_Parameters().get_ValueChoice().set_String(L"degree"));
        patch.get_Standard().setnil_Standard();
    }

    random_values values_{3};
    unsigned int number_ = 0;
};

} // namespace

std::unique_ptr<author> quality_control_author() {
    return std::make_unique<quality_control>();
}

} // namespace hqf_bench
