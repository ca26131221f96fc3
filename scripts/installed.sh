# shellcheck shell=bash
# To be sourced, behind packages.sh and quietly.sh: install_library installs the library for what is built against it,
# release_tool builds vorelpaint, python_with_the_package the package of Python, project_with_the_package that of
# JavaScript.

# install_library: says where it is
install_library() {
    local build=$PWD/build/examples
    quietly cmake -S . -B "$build/library" -G Ninja -DCMAKE_BUILD_TYPE=Release \
        -DCMAKE_INSTALL_PREFIX="$build/prefix" && quietly cmake --build "$build/library" --target install &&
        echo "$build/prefix"
}

# release_tool: builds vorelpaint in build/release, for what compares its pictures
release_tool() {
    need_packages cmake ninja-build g++ pkg-config libfreetype-dev libfribidi-dev libharfbuzz-dev libunibreak-dev \
        libfontconfig-dev libpng-dev libdeflate-dev nlohmann-json3-dev libcli11-dev
    [[ -f build/release/build.ninja ]] || quietly cmake --preset release
    quietly cmake --build --preset release --target vorelpaint
}

# python_with_the_package: says which Python has the package; that of scripts/python.sh, which runs where it has not
python_with_the_package() {
    local python=$PWD/build/python-venv/bin/python
    [[ -x $python ]] || quietly scripts/python.sh
    echo "$python"
}

# project_with_the_package: says which folder has the package of JavaScript; that of scripts/js.sh, which runs where it
# has not
project_with_the_package() {
    local project=$PWD/build/js-consumer
    [[ -f $project/node_modules/voreleffect/package.json ]] || quietly scripts/js.sh
    echo "$project"
}
