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

    /// How many lines with anything but blanks follow; 0 when only reading them would tell.
    size_t countAhead();

  private:
    std::string mName;
    std::FILE* mFile;
    size_t mNumber = 0;
};

}  // namespace vorelpaint
