#include "line_reader.h"

#include <fcntl.h>
#include <poll.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>

#include "error.h"

namespace vorelpaint {
namespace {

/// What never ends a line is no list of lines.
constexpr size_t kLongestLine = size_t{1} << 26;
constexpr size_t kMostAhead = size_t{1} << 20;
constexpr size_t kBlock = size_t{1} << 16;

}  // namespace

LineReader::LineReader(const std::string& path)
    : mName(path == "-" ? "standard input" : inQuotes(path)),
      mFile(path == "-" ? STDIN_FILENO : ::open(path.c_str(), O_RDONLY | O_CLOEXEC)) {
    if (mFile < 0) failWithErrno("cannot read " + mName);
    if (canRewind()) mStart = ::lseek(mFile, 0, SEEK_CUR);
}

LineReader::~LineReader() {
    if (mFile != STDIN_FILENO) ::close(mFile);
}

std::optional<std::string> LineReader::next(size_t maxBytes) {
    std::string line;
    size_t length = 0;
    bool isFound = false;
    while (!isFound) {
        if (mAt == mBuffer.size() && !mIsEnded) fill();
        if (mIsEnded && mAt == mBuffer.size()) break;
        const size_t end = std::min(mBuffer.find('\n', mAt), mBuffer.size());
        isFound = end < mBuffer.size();
        line.append(mBuffer, mAt, std::min(end - mAt, maxBytes + 1 - line.size()));
        length += end - mAt;
        mAt = end + (isFound ? 1 : 0);
        if (length > kLongestLine) {
            throw ToolError(mName + ", line " + std::to_string(mNumber + 1) + ": does not end within " +
                            std::to_string(kLongestLine) + " bytes");
        }
    }
    if (!isFound && length == 0) return std::nullopt;
    ++mNumber;
    return line;
}

bool LineReader::hasLine() const {
    return mIsEnded || mBuffer.size() - mAt > kMostAhead || mBuffer.find('\n', mAt) != std::string::npos;
}

bool LineReader::isReady() {
    while (!hasLine()) {
        pollfd input{mFile, POLLIN, 0};
        if (::poll(&input, 1, 0) <= 0) return false;
        fill();
    }
    return true;
}

/// Reads on behind what there is.
void LineReader::fill() {
    mBuffer.erase(0, mAt);
    mAt = 0;
    const size_t before = mBuffer.size();
    mBuffer.resize(before + kBlock);
    ssize_t count = -1;
    do {
        count = ::read(mFile, &mBuffer[before], kBlock);
    } while (count < 0 && errno == EINTR);
    mBuffer.resize(before + static_cast<size_t>(std::max(count, ssize_t{0})));
    if (count < 0) failWithErrno("cannot read " + mName);
    mIsEnded = count == 0;
}

bool LineReader::canRewind() const {
    struct stat status {};
    return ::fstat(mFile, &status) == 0 && S_ISREG(status.st_mode);
}

void LineReader::rewind() {
    if (::lseek(mFile, mStart, SEEK_SET) < 0) failWithErrno("cannot read " + mName);
    mBuffer.clear();
    mAt = 0;
    mIsEnded = false;
    mNumber = 0;
}

}  // namespace vorelpaint
