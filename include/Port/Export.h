/// \file
/// Marks what the library exports. The library is built with hidden visibility; a static build
/// defines ORN_HDL_STATIC for itself and, through its CMake target, for its users.
#pragma once

#if defined(_MSVC_LANG) ? _MSVC_LANG < 201703L : __cplusplus < 201703L
#error "the headers of Orn_Hdl need C++17, for instance -std=c++17"
#endif

/// \def ORN_HDL_API
/// Marks the declaration of an exported name.
/// \def ORN_HDL_LOCAL
/// Marks a member of an exported class that is not exported.
#if defined(ORN_HDL_STATIC)
#define ORN_HDL_API
#define ORN_HDL_LOCAL
#elif defined(_WIN32)
#define ORN_HDL_LOCAL
#if defined(ORN_HDL_BUILD)
#define ORN_HDL_API __declspec(dllexport)
#else
#define ORN_HDL_API __declspec(dllimport)
#endif
#else
#define ORN_HDL_API __attribute__((visibility("default")))
#define ORN_HDL_LOCAL __attribute__((visibility("hidden")))
#endif
