#pragma once

#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
#define ND_IS_SANITIZED true
#elif defined(__has_feature)
#if __has_feature(address_sanitizer) || __has_feature(thread_sanitizer)
#define ND_IS_SANITIZED true
#endif
#endif
#ifndef ND_IS_SANITIZED
#define ND_IS_SANITIZED false
#endif

namespace nidus {

/// Whether the address or the thread sanitizer adds functions and memory of its own.
inline constexpr bool kIsSanitized = ND_IS_SANITIZED;

}  // namespace nidus
