#pragma once
// Symbol visibility of the library: everything is hidden unless marked SVYMATH_API.
#if defined(_WIN32)
#if defined(SVYMATH_BUILDING)
#define SVYMATH_API __declspec(dllexport)
#else
#define SVYMATH_API __declspec(dllimport)
#endif
#else
#define SVYMATH_API __attribute__((visibility("default")))
#endif
