#pragma once

#include <cstdint>

namespace vorelcompose {

/// What tells that a file is still the one that was read, with the same in it: its place in the file
/// system, size and time of change. All 0 where there is no file. Of a file that has just changed it
/// tells nothing: the next change may leave the same time.
struct FileMark {
    uint64_t device = 0;
    uint64_t number = 0;
    int64_t size = 0;
    int64_t seconds = 0;
    int64_t nanoseconds = 0;
    bool isSettled = true;  ///< the file changed longer ago than the clock of a file system ticks

    /// Two of a file that has just changed are never the same.
    bool operator==(const FileMark& other) const;
};

}  // namespace vorelcompose
