#include <android/log.h>
#include <gtest/gtest.h>
#include <voreleffect/VFLog.h>

#include <string>
#include <utility>

using namespace VFontEffect;

namespace {

static_assert(ANDROID_LOG_DEBUG == 3 && ANDROID_LOG_INFO == 4 && ANDROID_LOG_WARN == 5 &&
                  ANDROID_LOG_ERROR == 6,
              "the priorities that VFLog passes are those of the real header");

std::string printed(VFLogLevel level) {
    ::testing::internal::CaptureStderr();
    VFLog::printLog(level, "x", "n=%d", 3);
    return ::testing::internal::GetCapturedStderr();
}

TEST(HostLiblog, Line_ReachesTheRealFunctionWithItsTagAndPriority) {
    const std::pair<VFLogLevel, char> levels[] = {
        {VFLogDebug, 'D'}, {VFLogInfo, 'I'}, {VFLogWarning, 'W'}, {VFLogError, 'E'}};
    for (const auto& [level, letter] : levels) {
        const std::string line = printed(level);
        EXPECT_NE(line.find("vfeffect"), std::string::npos) << line;
        EXPECT_NE(line.find("[x] n=3 \n"), std::string::npos) << line;
        EXPECT_NE(line.find(std::string(" ") + letter + " "), std::string::npos) << line;
    }
}

TEST(HostLiblog, MaskedLevel_PrintsNothing) {
    VFLog::setPrintLogLevel(0xFF & ~VFLogError);
    EXPECT_EQ(printed(VFLogError), "");
    VFLog::setPrintLogLevel(0xFF);
}

}  // namespace

int main(int argc, char** argv) {
    // On a host liblog drops debug lines unless told otherwise.
    __android_log_set_minimum_priority(ANDROID_LOG_VERBOSE);
    ::testing::InitGoogleTest(&argc, argv);
    return RUN_ALL_TESTS();
}
