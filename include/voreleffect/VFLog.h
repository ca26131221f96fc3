#pragma once

#include "VFExport.h"

namespace VFontEffect {

/// Levels of the log, one bit each; a mask of enabled levels is their bitwise or.
enum VFLogLevel : int {
    VFLogDebug = 1,    ///< Android priority debug
    VFLogInfo = 2,     ///< Android priority info; also the level of every timing line
    VFLogWarning = 4,  ///< Android priority warn
    VFLogError = 8,    ///< Android priority error
    VFLogTime = 16     ///< switches printTime on; a line printed at this level has priority info
};

/// A small logging facility for callers: writes to the Android log under the tag "vfeffect",
/// filtered by a process-wide mask of levels. The library's own drawing code never logs.
///
/// On Android lines go to liblog. On another system they go to `__android_log_print` where the
/// process has one (it links a host liblog, or defines the function itself), else to stderr.
///
/// The mask is an unsynchronised byte: set it before other threads log.
class VF_API VFLog {
  public:
    VFLog();
    ~VFLog();

    /// Replaces the mask of enabled levels. 0 silences everything.
    static void setPrintLogLevel(unsigned char mask);

    /// Prints the line "[tag] message \n" when `level` shares a bit with the mask.
    ///
    /// A null `format`, or a tag of 256 characters or more, prints nothing. A null tag prints as an
    /// empty one. The message is cut at 1023 characters.
    static void printLog(VFLogLevel level, const char* tag, const char* format, ...)
        __attribute__((format(printf, 3, 4)));

    /// Prints "[Time] label 1.500ms" at level info, when the mask has VFLogTime and VFLogInfo.
    /// A null label prints as an empty one.
    static void printTime(const char* tag, const char* label, long microseconds);

    /// The same line, followed by a blank and a formatted text of at most 1023 characters (the
    /// whole message is cut at 1023). A null `format` appends an empty text.
    static void printTime(const char* tag, const char* label, long microseconds, const char* format, ...)
        __attribute__((format(printf, 4, 5)));

    static unsigned char mCurrentLogLevel;  ///< the mask of enabled levels; 0xFF at the start
};

}  // namespace VFontEffect
