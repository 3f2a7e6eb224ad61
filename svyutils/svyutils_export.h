#pragma once
// Symbol visibility of the companion library: everything is hidden unless marked SVYUTILS_API.
#if defined(_WIN32)
#if defined(SVYUTILS_BUILDING)
#define SVYUTILS_API __declspec(dllexport)
#else
#define SVYUTILS_API __declspec(dllimport)
#endif
#else
#define SVYUTILS_API __attribute__((visibility("default")))
#endif
