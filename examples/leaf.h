/// A colour made from nothing: CIE test colour sample 14, an olive green leaf. Used by rendition_chart.cpp.
#pragma once

#include "hqf/hqf.h"

/// Turns the code of a setter into an exception, so that a long edit reads as one. The library itself throws none.
///
/// \throws lmx::c_lmx_exception for any code but 0
void must(lmx::elmx_error code);

/// Gives an empty colour a name, a number, a spectrum, and CIELAB and sRGB values.
///
/// \param when the entry of its change history and of each of its forms
/// \throws lmx::c_lmx_exception when a value is out of its range
void fill_leaf(hqf_v2::ColorType& leaf, const lmx::c_datetime& when);
