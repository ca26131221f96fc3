#include "file_mark.h"

#include <sys/stat.h>

#include <tuple>

namespace vorelpaint {
namespace {

auto tied(const FileMark& mark) {
    return std::tie(mark.device, mark.number, mark.size, mark.seconds, mark.nanoseconds);
}

}  // namespace

bool FileMark::operator==(const FileMark& other) const {
    return tied(*this) == tied(other);
}

FileMark markOf(const std::filesystem::path& path) {
    struct stat status {};
    if (::stat(path.c_str(), &status) != 0) return {};
    return {status.st_dev, status.st_ino, status.st_size, status.st_ctim.tv_sec, status.st_ctim.tv_nsec};
}

}  // namespace vorelpaint
