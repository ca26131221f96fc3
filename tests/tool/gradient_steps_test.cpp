/// The steps of ramps across wide texts, and what makes them smaller.
#include <gtest/gtest.h>

#include <cstdlib>
#include <string>

#include "painting.h"

namespace vorelpaint {
namespace {

using voreltext::Image;

/// Once around the circle of hues: steps of 6 of the 255 values of a channel.
constexpr const char* kHues = R"("gradient": [
    { "color": "#FF0000", "location": 0 },
    { "color": "#00FF00", "location": 0.33 },
    { "color": "#0000FF", "location": 0.67 },
    { "color": "#FF0000", "location": 1 }])";

/// How the colours change along a row of a picture.
struct Steps {
    int count = 0;
    int sum = 0;  ///< of the values by which the channels change

    double mean() const { return static_cast<double>(sum) / count; }
};

/// Along the middle of three words of full blocks, without the pixels of the words' ends.
Steps stepsOf(const std::string& style) {
    const std::string block = "\u2588\u2588\u2588\u2588\u2588\u2588\u2588\u2588";
    Options options;
    options.text = block + " " + block + " " + block;
    options.size = 100;
    options.inlineStyle = vorelstyle::parseStyle(style);
    const Image image = composed(options).paint();
    EXPECT_GT(image.width, 3 * 256);

    const uint8_t* row = image.pixels.data() + 4 * static_cast<size_t>(image.height / 2 * image.width);
    const auto isInside = [&](int x) { return row[4 * x + 3] == 255 && row[4 * (x - 1) + 3] == 255; };
    Steps steps;
    for (int x = 2; x < image.width - 1; ++x) {
        if (!isInside(x - 1) || !isInside(x) || !isInside(x + 1)) continue;
        int change = 0;
        for (int channel = 0; channel < 3; ++channel)
            change += std::abs(row[4 * x + channel] - row[4 * (x - 1) + channel]);
        steps.count += change > 0 ? 1 : 0;
        steps.sum += change;
    }
    return steps;
}

std::string ramp(const std::string& keys, const std::string& look = "") {
    return "{" + look + "\"linearGradient\": {\"angle\": 0, " + keys + kHues + "}}";
}

std::string ofVersion2(const std::string& look) {
    return "{\"version\": 2, " + look.substr(1);
}

TEST(GradientSteps, OneRamp_HasLessThan256) {
    EXPECT_LT(stepsOf(ramp("")).count, 256);
}

TEST(GradientSteps, RampForEachWord_HasAsManyInEach) {
    const int ofOne = stepsOf(ramp("")).count;
    const int ofEach = stepsOf(ofVersion2(ramp("", "\"span\": \"word\", "))).count;
    EXPECT_GT(ofEach, ofOne * 5 / 2);
}

TEST(GradientSteps, SecondRampBetween_MakesThemSmaller) {
    const Steps one = stepsOf(ramp(""));
    const Steps two = stepsOf("{\"version\": 2, \"looks\": [" + ramp("") + ", " +
                              ramp("\"scale\": 0.98, \"opacity\": 0.5, ", "\"fill\": false, ") + "]}");
    EXPECT_GT(two.count, one.count * 3 / 2);
    EXPECT_LT(two.mean(), one.mean() * 2 / 3);
}

}  // namespace
}  // namespace vorelpaint
