#include <gtest/gtest.h>

#include <string>

#include "voreleffect/voreleffect.h"

namespace {

// The numbers can be asked by the preprocessor, which is where callers need them.
#if VOREL_VERSION < VOREL_VERSION_NUMBER(0, 9, 0)
#error "older than the first version that has these macros"
#endif

TEST(Version, Numbers_StandInTheOrderOfVersions) {
    EXPECT_LT(VOREL_VERSION_NUMBER(0, 9, 0), VOREL_VERSION_NUMBER(0, 9, 1));
    EXPECT_LT(VOREL_VERSION_NUMBER(0, 9, 99), VOREL_VERSION_NUMBER(0, 10, 0));
    EXPECT_LT(VOREL_VERSION_NUMBER(0, 99, 99), VOREL_VERSION_NUMBER(1, 0, 0));
}

TEST(Version, NumberAndText_TellTheSameVersion) {
    const int major = VOREL_VERSION / 1000000;
    const int minor = VOREL_VERSION / 1000 % 1000;
    const int patch = VOREL_VERSION % 1000;
    EXPECT_EQ(VOREL_VERSION_STRING,
              std::to_string(major) + "." + std::to_string(minor) + "." + std::to_string(patch));
}

}  // namespace
