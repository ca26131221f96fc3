#include <cstdlib>

// In a module nobody reads what a C++ library prints before it gives up, and printing would have to be
// imported: it gives up in silence.

extern "C" [[noreturn]] void abort_message(const char* /*format*/, ...) {
    std::abort();
}

namespace std {
inline namespace _LIBCPP_ABI_NAMESPACE {
[[noreturn]] void __libcpp_verbose_abort(const char* /*format*/, ...) {
    std::abort();
}
}  // namespace _LIBCPP_ABI_NAMESPACE
}  // namespace std
