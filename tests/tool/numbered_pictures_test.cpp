#include "numbered_pictures.h"

#include <gtest/gtest.h>

#include <chrono>
#include <filesystem>
#include <string>
#include <thread>
#include <vector>

#include "error.h"
#include "program.h"

namespace vorelpaint {
namespace {

using Bytes = std::vector<uint8_t>;
using vorel_test::readBytes;

class NumberedPicturesBy : public ::testing::TestWithParam<int> {
  protected:
    NumberedName name() { return NumberedName::parse(mDir.file("%02d")).value(); }
    std::string pathOf(int64_t number) { return name().with(number); }

    vorel_test::TempDir mDir;
};

/// Early ones take longer than late ones.
TEST_P(NumberedPicturesBy, EveryNumber_HasItsBytes) {
    NumberedPictures pictures(name(), GetParam(), "pictures", 60);
    std::shared_ptr<NumberedPictures::File> tenth;
    for (int i = 0; i < 20; ++i) {
        auto file = pictures.add(i, [i](Workbench&) {
            std::this_thread::sleep_for(std::chrono::milliseconds(20 - i));
            return Bytes(static_cast<size_t>(i + 1), static_cast<uint8_t>(i));
        });
        if (i == 10) tenth = file;
    }
    for (int i = 20; i < 60; ++i)
        pictures.repeat(i, tenth);
    pictures.finish();
    for (int i = 0; i < 20; ++i)
        EXPECT_EQ(readBytes(pathOf(i)), std::string(static_cast<size_t>(i + 1), static_cast<char>(i)));
    for (int i = 20; i < 60; ++i)
        EXPECT_EQ(readBytes(pathOf(i)), readBytes(pathOf(10)));
}

/// What is repeated for long does not wait for its end to be written.
TEST_P(NumberedPicturesBy, RepeatedOnes_AreWrittenOnTheWay) {
    NumberedPictures pictures(name(), GetParam(), "pictures", 1000);
    const auto file = pictures.add(0, [](Workbench&) { return Bytes{1}; });
    for (int i = 1; i < 1000; ++i)
        pictures.repeat(i, file);
    EXPECT_EQ(readBytes(pathOf(700)), "\x01");
    pictures.finish();
    EXPECT_EQ(readBytes(pathOf(999)), "\x01");
}

TEST_P(NumberedPicturesBy, AFault_EndsThemBehindThoseBefore) {
    NumberedPictures pictures(name(), GetParam(), "pictures", 3);
    const auto run = [&] {
        pictures.add(0, [](Workbench&) { return Bytes{1}; });
        pictures.add(1, [](Workbench&) -> Bytes { throw ToolError("no"); });
        pictures.add(2, [](Workbench&) { return Bytes{1}; });
        pictures.finish();
    };
    EXPECT_THROW(run(), ToolError);
    EXPECT_TRUE(std::filesystem::exists(pathOf(0)));
    EXPECT_FALSE(std::filesystem::exists(pathOf(1)));
    EXPECT_FALSE(std::filesystem::exists(pathOf(2)));
}

INSTANTIATE_TEST_SUITE_P(Threads, NumberedPicturesBy, ::testing::Values(1, 2, 5));

}  // namespace
}  // namespace vorelpaint
