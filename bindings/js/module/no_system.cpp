#include <cstdint>

// The C library asks a system for files and its environment, of which a module has none: what it may do
// there fails, and nothing has to be imported.

extern "C" {

constexpr int kNoSuchCall = 52;  // of WASI

int __wasi_environ_sizes_get(uint32_t* count, uint32_t* bytes) {
    *count = 0;
    *bytes = 0;
    return 0;
}
int __wasi_environ_get(uint8_t** /*entries*/, uint8_t* /*bytes*/) {
    return 0;
}
int __wasi_fd_close(int /*file*/) {
    return kNoSuchCall;
}
int __wasi_fd_seek(int /*file*/, int64_t /*offset*/, uint8_t /*from*/, uint64_t* /*place*/) {
    return kNoSuchCall;
}
int __wasi_fd_write(int /*file*/, const void* /*parts*/, uint32_t /*count*/, uint32_t* /*written*/) {
    return kNoSuchCall;
}
[[noreturn]] void __wasi_proc_exit(uint32_t /*code*/) {
    __builtin_trap();
}

}  // extern "C"
