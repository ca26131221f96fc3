/// Options of the sanitizers, built in so that a finding replays without an environment. They mean
/// nothing to a build without sanitizers.

/// A size that no text effect has gives null, as on a device that runs out of memory, instead of
/// gigabytes of shadow memory.
extern "C" const char* __asan_default_options() {
    return "allocator_may_return_null=1:max_allocation_size_mb=64";
}

extern "C" const char* __ubsan_default_options() {
    return "print_stacktrace=1";
}
