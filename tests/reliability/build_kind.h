#pragma once

/// What this build is: sanitizers and emulators are many times slower and hold memory of their own.

#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
#define VOREL_TEST_SANITIZED 1
#elif defined(__has_feature)
#if __has_feature(address_sanitizer) || __has_feature(thread_sanitizer)
#define VOREL_TEST_SANITIZED 1
#endif
#endif
#ifndef VOREL_TEST_SANITIZED
#define VOREL_TEST_SANITIZED 0
#endif

namespace vorel_test {

constexpr bool kSanitized = VOREL_TEST_SANITIZED != 0;

/// Set by the build where the tests run under an emulator.
#ifdef VOREL_SLOW
constexpr bool kEmulated = true;
#else
constexpr bool kEmulated = false;
#endif

/// `plain` repetitions, or a tenth of them where each takes many times as long.
constexpr int repetitions(int plain) {
    return kEmulated ? (plain + 9) / 10 : plain;
}

}  // namespace vorel_test
