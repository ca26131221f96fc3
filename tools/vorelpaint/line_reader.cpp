#include "line_reader.h"

#include <sys/stat.h>

#include "error.h"

namespace vorelpaint {
namespace {

/// What never ends a line is no list of lines.
constexpr size_t kLongestLine = size_t{1} << 26;

bool isBlank(int c) {
    return c == ' ' || c == '\t' || c == '\r';
}

}  // namespace

LineReader::LineReader(const std::string& path)
    : mName(path == "-" ? "standard input" : inQuotes(path)),
      mFile(path == "-" ? stdin : std::fopen(path.c_str(), "rb")) {
    if (mFile == nullptr) failWithErrno("cannot read " + mName);
}

LineReader::~LineReader() {
    if (mFile != stdin) std::fclose(mFile);
}

std::optional<std::string> LineReader::next(size_t maxBytes) {
    std::string line;
    size_t length = 0;
    int c = std::getc(mFile);
    if (c == EOF && std::ferror(mFile) == 0) return std::nullopt;
    ++mNumber;
    for (; c != EOF && c != '\n'; c = std::getc(mFile)) {
        if (line.size() <= maxBytes) line += static_cast<char>(c);
        if (++length > kLongestLine) {
            throw ToolError(mName + ", line " + std::to_string(mNumber) + ": does not end within " +
                            std::to_string(kLongestLine) + " bytes");
        }
    }
    if (std::ferror(mFile) != 0) failWithErrno("cannot read " + mName);
    return line;
}

size_t LineReader::countAhead() {
    struct stat status {};
    if (::fstat(::fileno(mFile), &status) != 0 || !S_ISREG(status.st_mode)) return 0;
    const long here = std::ftell(mFile);
    size_t count = 0;
    bool counted = false;  // the line that is being read
    for (int c = std::getc(mFile); c != EOF; c = std::getc(mFile)) {
        if (c == '\n') {
            counted = false;
        } else if (!counted && !isBlank(c)) {
            counted = true;
            ++count;
        }
    }
    std::clearerr(mFile);
    if (std::fseek(mFile, here, SEEK_SET) != 0) failWithErrno("cannot read " + mName);
    return count;
}

}  // namespace vorelpaint
