# shellcheck shell=bash
# To be sourced: need_packages installs the Debian packages that are missing.

# need_packages PACKAGE...
need_packages() {
    local package missing=()
    for package in "$@"; do
        if [ "$(dpkg-query -W -f '${db:Status-Status}' "$package" 2>/dev/null)" != installed ]; then
            missing+=("$package")
        fi
    done
    [ ${#missing[@]} -eq 0 ] && return 0
    if [ "$(id -u)" -ne 0 ]; then
        echo "missing packages: ${missing[*]} (install them, or run this as root)" >&2
        return 1
    fi
    # One script at a time: they may run side by side.
    (
        flock 9
        apt-get -qq update >/dev/null &&
            DEBIAN_FRONTEND=noninteractive apt-get -qq -y --no-install-recommends \
                install "${missing[@]}" >/dev/null
    ) 9> "${TMPDIR:-/tmp}/voreleffect-packages.lock" && return 0
    echo "could not install: ${missing[*]}" >&2
    return 1
}
