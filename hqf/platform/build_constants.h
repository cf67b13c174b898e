/// How the runtime is built, for sources that ask before they are compiled. The flat layer gives the same numbers.
#pragma once

#define LMXNULL 0
/// What the schema doesn't allow ends a load; no switch changes that.
#define LMX_XML_STRICT 1
/// Reading checks pattern facets.
#define LMX_VALIDATE_PATTERNS 1
/// Decimals can be set from floating-point numbers.
#define LMX_WANT_DECIMAL_FLOAT_SET 1
/// Errors are codes, not exceptions.
#define LMX_USE_EXCEPTIONS 0
/// Text is wide.
#define LMX_NARROW_UNICODE_STRINGS 0
#define LMX_WANT_DLL 0
#define LMX_WANT_GEN_IMPORT_DLL 0
/// How floating-point numbers become text: one of the three modes behind it.
#define LMX_ATOFLOAT_MODE 0
#define LMX_ATOFLOAT_MODE_DEFAULT 0
#define LMX_ATOFLOAT_MODE_USE_FACET 1
#define LMX_ATOFLOAT_MODE_IOSTREAM 2
#define LMX_ATOFLOAT_MODE_SIMPLE 3
