#include "file_mark.h"

#include <sys/stat.h>

#include <ctime>
#include <tuple>

namespace vorelpaint {
namespace {

/// In seconds; some file systems count no finer than two.
constexpr std::time_t kTick = 2;

auto tied(const FileMark& mark) {
    return std::tie(mark.device, mark.number, mark.size, mark.seconds, mark.nanoseconds);
}

}  // namespace

bool FileMark::operator==(const FileMark& other) const {
    return isSettled && other.isSettled && tied(*this) == tied(other);
}

FileMark markOf(const std::filesystem::path& path) {
    struct stat status {};
    if (::stat(path.c_str(), &status) != 0) return {};
    return {status.st_dev,          status.st_ino,
            status.st_size,         status.st_ctim.tv_sec,
            status.st_ctim.tv_nsec, std::time(nullptr) > status.st_ctim.tv_sec + kTick};
}

}  // namespace vorelpaint
