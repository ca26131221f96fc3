#include "style/nearest.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace vorelstyle {
namespace {

TEST(Nearest, Choices_BeginWithTheOneThatIsMeant) {
    const std::vector<std::string> names{"gold", "neon"};
    EXPECT_EQ(choices("glod", names, "there are"), "; did you mean gold? There are gold, neon");
    EXPECT_EQ(choices("none", names, "there are"), "; there are gold, neon");
}

TEST(Nearest, NoneOf_EndsWithTheOneThatIsMeant) {
    const std::vector<std::string> names{"left", "center"};
    EXPECT_EQ(noneOf("centre", names), "none of left, center; did you mean center?");
    EXPECT_EQ(noneOf("middle", names), "none of left, center");
}

}  // namespace
}  // namespace vorelstyle
