#pragma once

namespace voreltext {

/// For a std::unique_ptr to an object of a C library that `kDestroy` gives back.
template <auto kDestroy>
struct Destroy {
    template <typename T>
    void operator()(T* object) const {
        kDestroy(object);
    }
};

}  // namespace voreltext
