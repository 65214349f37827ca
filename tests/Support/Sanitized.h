// Whether a sanitizer keeps the ways to memory for itself. GCC and Clang tell it in different ways.
#pragma once

#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
#define ORN_HDL_SANITIZED 1
#elif defined(__has_feature)
#if __has_feature(address_sanitizer) || __has_feature(thread_sanitizer)
#define ORN_HDL_SANITIZED 1
#endif
#endif
