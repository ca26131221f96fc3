#include "compose/system/presets.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>

#include "style/error.h"

namespace vorelcompose {
namespace {

using vorelstyle::StyleError;

TEST(Presets, Names_AreSortedAndThoseOfTheStyleFiles) {
    const std::vector<std::string> names = presetNames(VOREL_PRESETS);
    EXPECT_TRUE(std::is_sorted(names.begin(), names.end()));
    EXPECT_EQ(std::count(names.begin(), names.end(), "gold"), 1);
    EXPECT_EQ(std::count(names.begin(), names.end(), "chalk"), 1) << "it has a picture of this name too";
    EXPECT_EQ(std::count(names.begin(), names.end(), "stripes"), 0) << "a picture alone";
}

TEST(Presets, File_IsThatOfTheName) {
    EXPECT_EQ(presetFile(VOREL_PRESETS, "gold").filename(), "gold.json");
}

TEST(Presets, UnknownName_IsRefusedWithTheList) {
    try {
        presetFile(VOREL_PRESETS, "../presets/gold");
        FAIL() << "a path is no name";
    } catch (const StyleError& error) {
        EXPECT_EQ(std::string(error.what()).rfind("no preset '../presets/gold'; there are aurora, ", 0),
                  0U)
            << error.what();
    }
}

TEST(Presets, MissingDirectory_IsAStyleError) {
    EXPECT_THROW(presetNames("no/such/directory"), StyleError);
}

}  // namespace
}  // namespace vorelcompose
