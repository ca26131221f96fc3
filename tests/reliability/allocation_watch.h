#pragma once

/// Counting and refusing memory: malloc, calloc, realloc, free and the operators new and delete of
/// this program, and of the libraries that it loads, go through the functions behind this header.
namespace vorel_test {

/// Whether this build has them. The counts below stay 0 and nothing is refused where it has not.
bool canWatchMemory();

/// Blocks handed out and not given back yet, buffers and objects alike.
long liveBlocks();

/// The most bytes that were held at one time since it was made, beyond those held then, as the allocator
/// set them aside. One at a time; always 0 under a sanitizer.
class PeakMemory {
  public:
    PeakMemory();
    long bytes() const;

  private:
    long mBefore;
};

enum class Refusal { kOnce, kFromThenOn };

/// While it lives, the request number `first` (from 1) for memory that may fail is refused, and with
/// kFromThenOn every later one too. Plain operator new may not fail and is not counted.
class RefusedMemory {
  public:
    explicit RefusedMemory(long first, Refusal refusal = Refusal::kOnce);
    ~RefusedMemory();
    RefusedMemory(const RefusedMemory&) = delete;
    RefusedMemory& operator=(const RefusedMemory&) = delete;

    /// Requests made so far, refused ones included.
    static long requests();
    /// Whether the request to be refused was made.
    static bool refused();
};

/// While it lives, plain operator new throws.
class RefusedObjects {
  public:
    RefusedObjects();
    ~RefusedObjects();
    RefusedObjects(const RefusedObjects&) = delete;
    RefusedObjects& operator=(const RefusedObjects&) = delete;
};

/// Calls `step` and returns how many requests for memory that may fail it makes.
template <class Step>
long requestsOf(Step step) {
    const RefusedMemory counting(0);
    step();
    return RefusedMemory::requests();
}

}  // namespace vorel_test
