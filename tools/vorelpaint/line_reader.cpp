#include "line_reader.h"

#include <sys/stat.h>

#include "error.h"

namespace vorelpaint {
namespace {

/// What never ends a line is no list of lines.
constexpr size_t kLongestLine = size_t{1} << 26;

}  // namespace

LineReader::LineReader(const std::string& path)
    : mName(path == "-" ? "standard input" : inQuotes(path)),
      mFile(path == "-" ? stdin : std::fopen(path.c_str(), "rb")) {
    if (mFile == nullptr) failWithErrno("cannot read " + mName);
    if (canRewind()) mStart = std::ftell(mFile);
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

bool LineReader::canRewind() const {
    struct stat status {};
    return ::fstat(::fileno(mFile), &status) == 0 && S_ISREG(status.st_mode);
}

void LineReader::rewind() {
    std::clearerr(mFile);
    if (std::fseek(mFile, mStart, SEEK_SET) != 0) failWithErrno("cannot read " + mName);
    mNumber = 0;
}

}  // namespace vorelpaint
