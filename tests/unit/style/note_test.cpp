#include "style/note.h"

#include <gtest/gtest.h>

namespace vorelstyle {
namespace {

TEST(Note, Numbers_HaveTheirShortestSpelling) {
    EXPECT_EQ(spelled(136.0), "136");
    EXPECT_EQ(spelled(0.1F), "0.1");
    EXPECT_EQ(spelled(0.1), "0.1");
    EXPECT_EQ(spelled(-32767.0), "-32767");
    EXPECT_EQ(spelled(1.0F / 3), "0.33333334");
}

}  // namespace
}  // namespace vorelstyle
