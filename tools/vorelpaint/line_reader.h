#pragma once

#include <cstddef>
#include <cstdio>
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

    /// Whether it can be read anew: a pipe cannot.
    bool canRewind() const;

    /// Goes back to where it began.
    void rewind();

  private:
    std::string mName;
    std::FILE* mFile;
    long mStart = 0;  ///< in a file that others may have read before
    size_t mNumber = 0;
};

}  // namespace vorelpaint
