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

}  // namespace
}  // namespace vorelstyle
