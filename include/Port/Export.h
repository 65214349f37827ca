/// \file
/// Marks what the library exports. The library is built with hidden visibility; a static build
/// defines ORN_HDL_STATIC for itself and, through its CMake target, for its users.
#pragma once

/// \def ORN_HDL_API
/// Stands in the declaration of everything that is exported.
#if defined(ORN_HDL_STATIC)
#define ORN_HDL_API
#elif defined(_WIN32)
#if defined(ORN_HDL_BUILD)
#define ORN_HDL_API __declspec(dllexport)
#else
#define ORN_HDL_API __declspec(dllimport)
#endif
#else
#define ORN_HDL_API __attribute__((visibility("default")))
#endif
