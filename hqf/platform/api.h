#pragma once

/// Marks what libhqf.so shows to its users; everything else stays hidden in the library.
#if defined(_WIN32)
#if defined(HQF_BUILDING)
#define HQF_API __declspec(dllexport)
#else
#define HQF_API __declspec(dllimport)
#endif
#else
#define HQF_API __attribute__((visibility("default")))
#endif
