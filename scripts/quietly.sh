# shellcheck shell=bash
# To be sourced: quietly shows what a step said only when it fails.

# quietly COMMAND...
quietly() {
    local said
    said=$("$@" 2>&1) || { printf '%s\n' "$said" "failed: $*" >&2; return 1; }
}
