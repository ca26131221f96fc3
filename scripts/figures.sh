# shellcheck shell=bash
# To be sourced: describe_run tells where figures were measured, write_figures puts them into a page.

# describe_run COMPILER
describe_run() {
    local model cores level
    model=$(sed -n '/^model name[^:]*: /{s///p;q}' /proc/cpuinfo)
    cores=$(nproc)
    level=$(grep -om 1 -w -e avx512_vnni -e avx2 /proc/cpuinfo | sort -r | head -n 1)
    echo "Commit $(git rev-parse --short HEAD), $("$1" --version | head -n 1);" \
        "$model, $cores cores, $level."
}

# write_figures MARK FILE PAGE: what stands between <!-- MARK --> and <!-- end of MARK --> becomes FILE.
write_figures() {
    if ! grep -qx "<!-- $1 -->" "$3" || ! grep -qx "<!-- end of $1 -->" "$3"; then
        echo "$3: no lines <!-- $1 --> and <!-- end of $1 -->" >&2
        return 1
    fi
    sed -i -e "/^<!-- $1 -->\$/,/^<!-- end of $1 -->\$/{//!d}" "$3"
    sed -i -e "/^<!-- $1 -->\$/r $2" "$3"
}
