#include <cmath>
#include <cstdarg>
#include <cstdio>
#include <cstring>

#include "core/float_state.h"
#include "voreleffect/VFLog.h"

#ifdef __ANDROID__
#include <android/log.h>
#else
// On a host the reference is weak: whoever defines the function in the process, a host liblog or the
// program itself, gets the lines.
extern "C" int __android_log_print(int priority, const char* tag, const char* format, ...)
    __attribute__((weak, format(printf, 3, 4)));
#endif

namespace VFontEffect {
namespace {

constexpr char kAndroidTag[] = "vfeffect";
constexpr size_t kTagBytes = 256;
constexpr size_t kMessageBytes = 1024;

constexpr int kPriorityDebug = 3;
constexpr int kPriorityInfo = 4;
constexpr int kPriorityWarn = 5;
constexpr int kPriorityError = 6;

int priorityOf(VFLogLevel level) {
    switch (level) {
        case VFLogDebug:
            return kPriorityDebug;
        case VFLogWarning:
            return kPriorityWarn;
        case VFLogError:
            return kPriorityError;
        default:
            return kPriorityInfo;
    }
}

void writeLine(int priority, const char* tag, const char* message) {
#ifndef __ANDROID__
    if (__android_log_print == nullptr) {
        std::fprintf(stderr, "[%s] %s \n", tag, message);
        return;
    }
#endif
    __android_log_print(priority, kAndroidTag, "[%s] %s \n", tag, message);
}

const char* orEmpty(const char* text) {
    return text != nullptr ? text : "";
}

/// Microseconds as milliseconds in single precision with three decimals: as "%.3f" prints them, but with
/// a point in every locale, and rounded to nearest in every floating-point state.
class Milliseconds {
  public:
    explicit Milliseconds(long microseconds) {
        internal::inOwnFloatState([&] {
            const double value = static_cast<double>(static_cast<float>(microseconds) / 1000.0F);
            // Exact until it is rounded: 24 bits times 10 bits.
            const double thousandths = std::nearbyint(std::fabs(value) * 1000.0);
            std::snprintf(mText, sizeof mText, "%s%04.0f", microseconds < 0 ? "-" : "", thousandths);
        });
        char* const decimals = mText + std::strlen(mText) - kDecimals;
        std::memmove(decimals + 1, decimals, kDecimals + 1);
        *decimals = '.';
    }

    const char* text() const { return mText; }

  private:
    static constexpr size_t kDecimals = 3;
    char mText[32];
};

}  // namespace

unsigned char VFLog::mCurrentLogLevel = 0xFF;

VFLog::VFLog() = default;
VFLog::~VFLog() = default;

void VFLog::setPrintLogLevel(unsigned char mask) {
    mCurrentLogLevel = mask;
}

void VFLog::printLog(VFLogLevel level, const char* tag, const char* format, ...) {
    if (format == nullptr || (mCurrentLogLevel & static_cast<unsigned int>(level)) == 0) return;
    if (std::strlen(orEmpty(tag)) >= kTagBytes) return;
    char message[kMessageBytes] = {};
    va_list arguments;
    va_start(arguments, format);
    std::vsnprintf(message, sizeof message, format, arguments);
    va_end(arguments);
    writeLine(priorityOf(level), orEmpty(tag), message);
}

void VFLog::printTime(const char* tag, const char* label, long microseconds) {
    if ((mCurrentLogLevel & VFLogTime) == 0) return;
    printLog(VFLogInfo, tag, "[Time] %s %sms", orEmpty(label), Milliseconds(microseconds).text());
}

void VFLog::printTime(const char* tag, const char* label, long microseconds, const char* format, ...) {
    if ((mCurrentLogLevel & VFLogTime) == 0) return;
    char extra[kMessageBytes] = {};
    if (format != nullptr) {
        va_list arguments;
        va_start(arguments, format);
        std::vsnprintf(extra, sizeof extra, format, arguments);
        va_end(arguments);
    }
    printLog(VFLogInfo, tag, "[Time] %s %sms %s", orEmpty(label), Milliseconds(microseconds).text(),
             extra);
}

}  // namespace VFontEffect
