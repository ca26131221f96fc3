#pragma once

#include <cstddef>

namespace vorelpaint {

/// Counts the memory that is handed out while it lives, in this program and in the libraries that it
/// loads. One at a time, and for one thread.
class MemoryMeter {
  public:
    MemoryMeter();
    ~MemoryMeter();
    MemoryMeter(const MemoryMeter&) = delete;
    MemoryMeter& operator=(const MemoryMeter&) = delete;

    /// The most bytes in use at one time, beyond those in use at the start.
    size_t peak() const;

    /// Whether this build can count; the peak stays 0 where it cannot.
    static bool works();
};

}  // namespace vorelpaint
