# shellcheck shell=bash
# To be sourced, behind quietly.sh: install_library installs the library for what is built against it.

# install_library: says where it is
install_library() {
    local build=$PWD/build/examples
    quietly cmake -S . -B "$build/library" -G Ninja -DCMAKE_BUILD_TYPE=Release \
        -DCMAKE_INSTALL_PREFIX="$build/prefix" && quietly cmake --build "$build/library" --target install &&
        echo "$build/prefix"
}
