#pragma once

#include <sys/types.h>

#include <cstddef>
#include <optional>
#include <string>

namespace vorelpaint {

/// Reads a file, or standard input for "-", line by line. Throws ToolError when it cannot be read.
class LineReader {
  public:
    explicit LineReader(const std::string& path);
    ~LineReader();
    LineReader(const LineReader&) = delete;
    LineReader& operator=(const LineReader&) = delete;

    /// The next line without its end; nothing behind the last one. A line longer than `maxBytes` is cut
    /// to one byte more.
    std::optional<std::string> next(size_t maxBytes);

    /// The number of the line that was read last, from 1.
    size_t number() const { return mNumber; }

    /// Whether next() has what it needs, so that it need not wait for who writes into a pipe. It may say
    /// so of a very long line that has not ended yet.
    bool isReady();

    /// What to wait for until isReady() can have changed.
    int descriptor() const { return mFile; }

    /// Whether it can be read anew: a pipe cannot.
    bool canRewind() const;

    /// Goes back to where it began.
    void rewind();

  private:
    bool hasLine() const;
    void fill();

    std::string mName;
    int mFile;
    off_t mStart = 0;     ///< in a file that others may have read before
    std::string mBuffer;  ///< what was read ahead
    size_t mAt = 0;       ///< how much of it is used
    bool mIsEnded = false;
    size_t mNumber = 0;
};

}  // namespace vorelpaint
