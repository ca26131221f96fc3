#include "compose/composition.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "compose/error.h"
#include "font_of_bytes.h"

namespace vorelcompose {
namespace {

class CompositionOfBytes : public ::testing::Test {
  protected:
    CompositionOfBytes() {
        mRequest.fonts = {"mine"};
        mRequest.size = 20;
    }
    Composition composed(const std::string& text, const char* style = "{}") {
        return {mRequest, SourceText(text, false),
                [style] {
                    return FoundStyle{std::make_shared<vorelstyle::Style>(vorelstyle::parseStyle(style)),
                                      {}};
                },
                mBench};
    }
    std::string faultOf(const std::string& text) {
        try {
            composed(text);
            return "";
        } catch (const ComposeError& error) {
            return error.what();
        }
    }

    FontOfBytes mFonts;
    Workbench mBench{mFonts};
    Request mRequest;
};

TEST_F(CompositionOfBytes, Picture_HasTheInkTheMarginsAndThePadding) {
    const Composition picture =
        composed("A", R"({"stroke": {"size": 3, "color": "#fff", "position": "outside"}})");
    const voreltext::Box& ink = picture.text().layout().inkBox();
    EXPECT_EQ(picture.canvas().width, ink.width() + 2 * (3 + 8));
    EXPECT_EQ(picture.canvas().height, ink.height() + 2 * (3 + 8));
    const voreltext::Image image = picture.paint();
    EXPECT_EQ(image.width, picture.canvas().width);
    EXPECT_EQ(image.pixels.size(), static_cast<size_t>(4 * image.width * image.height));
}

TEST_F(CompositionOfBytes, Fonts_AreOpenedOnceForAWorkbench) {
    composed("A");
    composed("B");
    EXPECT_EQ(mFonts.opened, 1);
}

TEST_F(CompositionOfBytes, TextIsSetBeforeItsStyleIsAskedFor) {
    const auto refuse = []() -> FoundStyle { throw ComposeError("the style"); };
    mRequest.fonts = {"none"};
    try {
        const Composition never(mRequest, SourceText("A", false), refuse, mBench);
        FAIL() << "composed";
    } catch (const ComposeError& error) {
        EXPECT_STREQ(error.what(), "no font 'none'");
    }
}

TEST_F(CompositionOfBytes, InvisibleText_IsRefused) {
    EXPECT_THROW(composed(" \n "), InvisibleText);
}

TEST_F(CompositionOfBytes, StrictRequest_ThrowsItsFirstNote) {
    EXPECT_EQ(faultOf("\xF0\x9F\x98\x80"), "");
    mRequest.strict = true;
    EXPECT_EQ(faultOf("A"), "");
    mRequest.canvas.width = 20;
    EXPECT_EQ(faultOf("AAAA").rfind("the picture cuts pixels of the text or its effects off: ", 0), 0U);
}

TEST(Request, FitWithoutASide_IsRefused) {
    Request request;
    EXPECT_NO_THROW(checkCanvas(request));
    request.fit = Fit::shrink;
    EXPECT_THROW(checkCanvas(request), ComposeError);
    request.canvas.height = 10;
    EXPECT_NO_THROW(checkCanvas(request));
    request.fit = Fit::wrap;
    EXPECT_THROW(checkCanvas(request), ComposeError);
    request.canvas.width = 10;
    EXPECT_NO_THROW(checkCanvas(request));
}

}  // namespace
}  // namespace vorelcompose
