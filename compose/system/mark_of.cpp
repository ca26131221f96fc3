#include "compose/system/mark_of.h"

#include <sys/stat.h>

#include <ctime>

namespace vorelcompose {
namespace {

/// In seconds; some file systems count no finer than two.
constexpr std::time_t kTick = 2;

}  // namespace

FileMark markOf(const std::filesystem::path& path) {
    struct stat status {};
    if (::stat(path.c_str(), &status) != 0) return {};
    return {status.st_dev,          status.st_ino,
            status.st_size,         status.st_ctim.tv_sec,
            status.st_ctim.tv_nsec, std::time(nullptr) > status.st_ctim.tv_sec + kTick};
}

}  // namespace vorelcompose
