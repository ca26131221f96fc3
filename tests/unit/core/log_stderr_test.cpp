#include <gtest/gtest.h>
#include <voreleffect/VFLog.h>

#include <string>

using namespace VFontEffect;

namespace {

TEST(LogWithoutAndroid, Line_GoesToStderr) {
    ::testing::internal::CaptureStderr();
    VFLog::printLog(VFLogWarning, "x", "n=%d", 3);
    VFLog::printTime("x", "blur", 1500);
    const std::string text = ::testing::internal::GetCapturedStderr();
    EXPECT_NE(text.find("[x] n=3 \n"), std::string::npos) << text;
    EXPECT_NE(text.find("[x] [Time] blur 1.500ms \n"), std::string::npos) << text;
}

TEST(LogWithoutAndroid, MaskedLevel_PrintsNothing) {
    VFLog::setPrintLogLevel(0);
    ::testing::internal::CaptureStderr();
    VFLog::printLog(VFLogError, "x", "n=%d", 3);
    EXPECT_EQ(::testing::internal::GetCapturedStderr(), "");
    VFLog::setPrintLogLevel(0xFF);
}

}  // namespace
