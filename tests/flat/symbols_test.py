"""Does the library export exactly what the generator lists, and does the list hold what callers bind to?

usage: symbols_test.py NM LIBRARY EXPORTS

The names and numbers below are written by hand on purpose: the list of the generator can't prove itself.
"""

import subprocess
import sys
from collections import Counter

# One name for each shape that no other test of this folder calls.
NAMES = """
    CSharp_new_Hqf__SWIG_1 CSharp_new_sg_ColorSpace__SWIG_1 CSharp_SampleUpcast CSharp_SampleSpotUpcast
    CSharp_SampleSpotTypeUpcast CSharp_DeviceFilterUpcast CSharp_CollectionColorSpaceSpecificationUpcast
    CSharp_Header_isset_Name CSharp_Header_unset_Name CSharp_Averaging_isset_Averaging CSharp_SDKVersion_get_SDKVersion
    CSharp_SDKVersion_isnil_SDKVersion CSharp_SDKVersion_setnil_SDKVersion
    CSharp_ColorSpaceSpecificationSpectrumTristimulus_setnil_ColorSpaceSpecificationSpectrumTristimulus
    CSharp_Header_get_ChangeHistory CSharp_Header_set_ChangeHistory CSharp_Header_append_ChangeHistory
    CSharp_Header_insert_ChangeHistory CSharp_Header_delete_ChangeHistory CSharp_Header_clear_ChangeHistory
    CSharp_Header_size_ChangeHistory CSharp_ColorType_assign_ColorSpace CSharp_ColorType_append_ColorSpace
    CSharp_ColorType_insert_ColorSpace CSharp_ColorType_clear_ColorSpace CSharp_ColorType_get_Owner__SWIG_0
    CSharp_ColorType_get_Substrate__SWIG_0 CSharp_ColorSpaceSRGBType_getenum_ColorDepth
    CSharp_ColorSpaceSRGBType_setenum_ColorDepth CSharp_GeometryChoiceType_getchosen
    CSharp_GeometryChoiceType_get_SphereGeometry CSharp_GeometryChoiceType_setenum_SphereGeometry
    CSharp_ValueChoice_set_Double CSharp_ProfileChoice_get_ProfileFile__SWIG_0 CSharp_ProfileChoice_assign_ProfileFile
    CSharp_IlluminationOptionsType_isset_Description CSharp_sg_ColorSpace_getchosen
    CSharp_sg_ColorSpace_get_ColorSpaceCIELab__SWIG_0 CSharp_sg_ColorSpace_assign_ColorSpaceCIELab
    CSharp_sg_Function_assign_FunctionDECMC CSharp_Hqf_swap CSharp_Hqf_reset CSharp_Hqf_is_occurs_ok
    CSharp_sg_Sample_is_occurs_ok CSharp_ColorSpaceCIELabType_clone CSharp_ColorSpaceCIELabType_getid
    CSharp_ColorSpaceCIELabType_has_id CSharp_ColorSpaceCIELab_getid CSharp_ColorSpaceCIELab_has_id
    CSharp_ColorSpaceCIELabType_id_set CSharp_SubstrateType_id_get CSharp_FunctionType_factory
    CSharp_ColorSpaceSpecificationEmissiveType_factory CSharp_ColorSpaceCIELab_unmarshal__SWIG_1
"""

# What looks like an export by one rule and is none by another.
ABSENT = """
    CSharp_HqfUpcast CSharp_ColorSpaceTypeUpcast CSharp_sg_SampleUpcast CSharp_new_Hqf CSharp_new_Hqf__SWIG_2
    CSharp_ColorType_get_ColorSpace CSharp_ColorType_get_ColorSpace__SWIG_1 CSharp_Header_get_ChangeHistory__SWIG_0
    CSharp_Header_get_Creator__SWIG_0 CSharp_Header_isset_Creator CSharp_Header_back_ChangeHistory
    CSharp_ColorType_isset_ColorSpace CSharp_sg_Function_assign_Function CSharp_sg_ColorSpace_is_member
    CSharp_ColorSpaceCIELab_get_L CSharp_ColorSpaceCIELab_id_get CSharp_Header_getid CSharp_Preamble_isset_Header
    CSharp_Hqf_marshal CSharp_Hqf_marshal__SWIG_1 CSharp_Hqf_unmarshal__SWIG_2 CSharp_Header_unmarshal__SWIG_0
    CSharp_ColorSpace_marshal__SWIG_0 CSharp_ColorSpaceCIELabType_factory CSharp_new_XMLDocumentResult__SWIG_0
    CSharp_new_c_big_int__SWIG_3 CSharp_new_c_decimal__SWIG_3 CSharp_new_c_pattern__SWIG_0 CSharp_c_gday_get_month
    CSharp_c_date_get_hours CSharp_c_duration_is_valid CSharp_c_datetime_base_get_year
"""

# Families of the model, by their counts: 205 classes; 5 roots, 63 type and 68 element classes in hierarchies; 4 groups
# and 7 choices; 68 elements with entry points.
COUNTS = {
    "_swap": 205 + 3, "_reset": 205, "_is_occurs_ok": 205, "_clone": 5 + 63 + 68, "_getid": 136, "_has_id": 136,
    "_id_get": 68, "_id_set": 68, "_factory": 5 + 2, "_getchosen": 4 + 7, "_marshal__SWIG_0": 68,
    "_unmarshal__SWIG_0": 68, "_unmarshal__SWIG_1": 68, "Upcast": 63 + 68 + 2,
}

DELETES = 205 + 1 + 17  # model, the result of a writing, runtime values

FAMILIES = {"registration": 3, "platform": 5, "own": 5}


def main(nm: str, library: str, exports: str) -> int:
    faults = []
    with open(exports, encoding="utf-8") as lines:
        rows = [line.split() for line in lines]
    listed = {name for _, name in rows}
    output = subprocess.run([nm, "-D", "--defined-only", library], check=True, capture_output=True, text=True).stdout
    # C++ names are mangled; of the plain ones a sanitizer brings some of its own.
    exported = {line.split()[-1] for line in output.splitlines()}
    ours = {name for name in exported if name.startswith(("CSharp_", "SWIG", "Sys", "hqf_"))}
    faults += [f"listed, but not exported: {name}" for name in sorted(listed - exported)]
    faults += [f"exported, but not listed: {name}" for name in sorted(ours - listed)]
    faults += [f"missing: {name}" for name in NAMES.split() if name not in listed]
    faults += [f"too many: {name}" for name in ABSENT.split() if name in listed]
    counts = {end: sum(name.endswith(end) for name in listed) for end in COUNTS}
    faults += [f"{end}: {counts[end]} exports, not {count}" for end, count in COUNTS.items() if counts[end] != count]
    deletes = sum(name.startswith("CSharp_delete_") for name in listed)
    faults += [f"{deletes} destructors, not {DELETES}"] * (deletes != DELETES)
    families = Counter(family for family, _ in rows)
    faults += [f"{name}: {families[name]}" for name, count in FAMILIES.items() if families[name] != count]
    faults += [f"another prefix than our own: {name}" for family, name in rows
               if (family == "own") != name.startswith("hqf_")]
    print("\n".join(faults) or f"{len(listed)} exports")
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main(*sys.argv[1:]))
