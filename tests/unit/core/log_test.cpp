#include <gtest/gtest.h>
#include <voreleffect/VFLog.h>

#include <algorithm>
#include <climits>
#include <clocale>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <vector>

#include "tests/support/float_states.h"

using namespace VFontEffect;

namespace {

struct Line {
    int priority;
    std::string tag;
    std::string format;
    std::string text;
};

std::vector<Line>& lines() {
    static std::vector<Line> captured;
    return captured;
}

const unsigned char kMaskAtStart = VFLog::mCurrentLogLevel;

}  // namespace

// Takes the place of Android's function: the library finds it in the running program.
extern "C" __attribute__((visibility("default"), format(printf, 3, 4))) int __android_log_print(
    int priority, const char* tag, const char* format, ...);

extern "C" int __android_log_print(int priority, const char* tag, const char* format, ...) {
    char text[4096];
    va_list arguments;
    va_start(arguments, format);
    std::vsnprintf(text, sizeof text, format, arguments);
    va_end(arguments);
    lines().push_back({priority, tag, format, text});
    return 1;
}

namespace {

class Log : public ::testing::Test {
  protected:
    Log() { lines().clear(); }
    ~Log() override { VFLog::setPrintLogLevel(0xFF); }

    static void expectLine(int priority, const std::string& text) {
        ASSERT_EQ(lines().size(), 1U);
        EXPECT_EQ(lines()[0].priority, priority);
        EXPECT_EQ(lines()[0].tag, "vfeffect");
        EXPECT_EQ(lines()[0].format, "[%s] %s \n");
        EXPECT_EQ(lines()[0].text, text);
        lines().clear();
    }
};

VFLogLevel level(int value) {
    return static_cast<VFLogLevel>(value);
}

TEST_F(Log, EverythingIsEnabledAtTheStart) {
    EXPECT_EQ(kMaskAtStart, 0xFF);
}

TEST_F(Log, Warning_PrintsTagAndMessage) {
    VFLog::printLog(VFLogWarning, "x", "n=%d", 3);
    expectLine(5, "[x] n=3 \n");
}

TEST_F(Log, EachLevel_HasItsPriority) {
    const std::pair<int, int> priorities[] = {{1, 3}, {2, 4}, {4, 5}, {8, 6}, {16, 4}};
    for (const auto& [value, priority] : priorities) {
        VFLog::printLog(level(value), "tag", "message");
        expectLine(priority, "[tag] message \n");
    }
}

TEST_F(Log, CombinedLevels_PrintAtInfo) {
    for (const int value : {3, 5, 6, 9, 12, 24, 31}) {
        VFLog::printLog(level(value), "tag", "message");
        expectLine(4, "[tag] message \n");
    }
}

TEST_F(Log, LevelZero_PrintsNothing) {
    VFLog::printLog(level(0), "tag", "message");
    EXPECT_TRUE(lines().empty());
}

TEST_F(Log, Level_PrintsOnlyWhenItSharesABitWithTheMask) {
    for (int mask = 0; mask < 256; ++mask) {
        VFLog::setPrintLogLevel(static_cast<unsigned char>(mask));
        EXPECT_EQ(VFLog::mCurrentLogLevel, mask);
        for (int value = 0; value < 32; ++value) {
            lines().clear();
            VFLog::printLog(level(value), "tag", "message");
            EXPECT_EQ(lines().size(), (mask & value) != 0 ? 1U : 0U) << mask << " " << value;
        }
    }
}

TEST_F(Log, MaskZero_SilencesEverything) {
    VFLog::setPrintLogLevel(0);
    for (const int value : {1, 2, 4, 8, 16})
        VFLog::printLog(level(value), "tag", "message");
    VFLog::printTime("tag", "label", 1500);
    VFLog::printTime("tag", "label", 1500, "%d", 1);
    EXPECT_TRUE(lines().empty());
}

TEST_F(Log, Tag_Of255CharactersPrintsAndOf256DoesNot) {
    const std::string longest(255, 't');
    VFLog::printLog(VFLogError, longest.c_str(), "message");
    expectLine(6, "[" + longest + "] message \n");
    VFLog::printLog(VFLogError, (longest + "t").c_str(), "message");
    EXPECT_TRUE(lines().empty());
}

TEST_F(Log, EmptyTagAndMessage_LeaveTheFrame) {
    VFLog::printLog(VFLogDebug, "", "%s", "");
    expectLine(3, "[]  \n");
}

TEST_F(Log, PercentSignsOfTagAndArguments_AreNotFormatted) {
    VFLog::printLog(VFLogDebug, "%s%n", "%s", "%d%%");
    expectLine(3, "[%s%n] %d%% \n");
}

TEST_F(Log, Message_IsCutAt1023Characters) {
    const std::string text(2000, 'm');
    for (const size_t length : {1022U, 1023U, 1024U, 2000U}) {
        VFLog::printLog(VFLogInfo, "tag", "%s", text.substr(0, length).c_str());
        expectLine(4, "[tag] " + text.substr(0, std::min<size_t>(length, 1023)) + " \n");
    }
}

// A format that is not a literal is the point of this test.
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wformat-security"
TEST_F(Log, NullArguments_PrintNothingOrAnEmptyText) {
    const char* none = nullptr;
    VFLog::printLog(VFLogInfo, "tag", none);
    EXPECT_TRUE(lines().empty());

    VFLog::printLog(VFLogInfo, none, "message");
    expectLine(4, "[] message \n");
    VFLog::printTime(none, none, 1500);
    expectLine(4, "[] [Time]  1.500ms \n");
    VFLog::printTime("tag", "label", 1500, none);
    expectLine(4, "[tag] [Time] label 1.500ms  \n");
}
#pragma GCC diagnostic pop

TEST_F(Log, Time_PrintsMillisecondsAtInfo) {
    VFLog::printTime("x", "blur", 1500);
    expectLine(4, "[x] [Time] blur 1.500ms \n");
}

TEST_F(Log, Time_PrintsThreeDecimals) {
    const std::pair<long, const char*> times[] = {
        {0, "0.000"}, {1, "0.001"}, {999, "0.999"}, {-1500, "-1.500"}, {1234567, "1234.567"}};
    for (const auto& [microseconds, text] : times) {
        VFLog::printTime("x", "t", microseconds);
        expectLine(4, std::string("[x] [Time] t ") + text + "ms \n");
    }
}

TEST_F(Log, Time_IsDividedInSinglePrecision) {
    // 100000001 is 100000000 in single precision; in double precision this would read 100000.001.
    VFLog::printTime("x", "t", 100000001);
    expectLine(4, "[x] [Time] t 100000.000ms \n");
}

TEST_F(Log, Time_RoundsToTheEvenThousandth) {
    // 131072.0625 and 131072.1875 in single precision, both half-way between two thousandths.
    VFLog::printTime("x", "t", 131072062);
    expectLine(4, "[x] [Time] t 131072.062ms \n");
    VFLog::printTime("x", "t", 131072187);
    expectLine(4, "[x] [Time] t 131072.188ms \n");
}

TEST_F(Log, Time_AtTheEndsOfItsRange) {
    // The single-precision number nearest to 2^63 / 1000; they are 2^30 apart there.
    VFLog::printTime("x", "t", LONG_MAX);
    expectLine(4, "[x] [Time] t 9223372474941440.000ms \n");
    VFLog::printTime("x", "t", LONG_MIN);
    expectLine(4, "[x] [Time] t -9223372474941440.000ms \n");
}

TEST_F(Log, Time_IsTheSameInEveryFloatingPointState) {
    for (const vorel_test::FloatState& state : vorel_test::floatStates()) {
        SCOPED_TRACE(state.name);
        {
            const vorel_test::InFloatState callers(state);
            VFLog::printTime("x", "t", 131072062);
        }
        expectLine(4, "[x] [Time] t 131072.062ms \n");
    }
}

TEST_F(Log, Time_HasAPointInEveryLocale) {
    if (std::getenv("LOCPATH") == nullptr) GTEST_SKIP() << "LOCPATH names no folder of locales";
    ASSERT_NE(std::setlocale(LC_NUMERIC, "de_DE.UTF-8"), nullptr);
    VFLog::printTime("x", "blur", 1500);
    expectLine(4, "[x] [Time] blur 1.500ms \n");
    VFLog::printTime("x", "blur", 2250, "%.1f", 0.5);
    // What the caller formats is the caller's.
    expectLine(4, "[x] [Time] blur 2.250ms 0,5 \n");
    std::setlocale(LC_NUMERIC, "C");
}

TEST_F(Log, TimeWithText_AppendsTheFormattedText) {
    VFLog::printTime("x", "blur", 2250, "%dx%d", 4, 3);
    expectLine(4, "[x] [Time] blur 2.250ms 4x3 \n");
}

TEST_F(Log, TimeWithLongText_IsCutAt1023Characters) {
    VFLog::printTime("x", "l", 0, "%s", std::string(3000, 'e').c_str());
    const std::string message = "[Time] l 0.000ms ";
    expectLine(4, "[x] " + message + std::string(1023 - message.size(), 'e') + " \n");
}

TEST_F(Log, TimingBitAlone_PrintsNoTimingLine) {
    VFLog::setPrintLogLevel(16);
    VFLog::printTime("x", "blur", 1500);
    VFLog::printTime("x", "blur", 1500, "text");
    EXPECT_TRUE(lines().empty());
}

TEST_F(Log, InfoBitAlone_PrintsNoTimingLine) {
    VFLog::setPrintLogLevel(2);
    VFLog::printTime("x", "blur", 1500);
    VFLog::printTime("x", "blur", 1500, "text");
    EXPECT_TRUE(lines().empty());
}

TEST_F(Log, TimingAndInfoBits_PrintTimingAndInfoLinesOnly) {
    VFLog::setPrintLogLevel(18);
    VFLog::printTime("x", "blur", 1500);
    expectLine(4, "[x] [Time] blur 1.500ms \n");
    VFLog::printLog(VFLogInfo, "x", "info");
    expectLine(4, "[x] info \n");
    for (const int value : {1, 4, 8})
        VFLog::printLog(level(value), "x", "other");
    EXPECT_TRUE(lines().empty());
}

}  // namespace
