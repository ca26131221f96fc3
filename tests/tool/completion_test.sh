#!/usr/bin/env bash
# The completions do in their shell what they are for: completion_test.sh VORELPAINT DIRECTORY SHELL,
# with the scripts in DIRECTORY.
set -euo pipefail
program=$1
scripts=$2
shell=$3
export PATH="${program%/*}:$PATH"

here=$(realpath "$(dirname "$0")")
scripts=$(realpath "$scripts")
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
cd "$work"
touch look.json lines.txt

# expect WHAT EXPECTED GOT
expect() {
    [[ $2 == "$3" ]] && return
    printf '%s: expected\n%s\ngot\n%s\n' "$1" "$2" "$3" >&2
    exit 1
}

# The words that the shell offers, one a line, sorted, without their descriptions.
offered_bash() {
    bash -c '
        source "$1"
        shift
        COMP_WORDS=("$@")
        COMP_CWORD=$((${#COMP_WORDS[@]} - 1))
        _vorelpaint
        [[ ${#COMPREPLY[@]} -eq 0 ]] || printf "%s\n" "${COMPREPLY[@]}"' - "$scripts/vorelpaint.bash" "$@"
}
offered_fish() {
    fish --no-config -c '
        source $argv[1]
        complete -C "$argv[2..]" | string replace -r "\t.*" ""' "$scripts/vorelpaint.fish" "$@"
}
# zsh completes only at a prompt: one is run on a terminal of its own, and asked to list what it would
# insert.
offered_zsh() {
    cp "$scripts/_vorelpaint" "$work/_vorelpaint"
    zsh -f "$here/zsh_offers.zsh" "$work" "$*"
}
offered() { "offered_$shell" vorelpaint "$@" | sort; }

presets=$("$program" --list-presets | cut -d ' ' -f 1)
expect "an option's beginning" $'--padding' "$(offered --pa)"
expect "an option's words" $'center\nend\nleft\nright\nstart' "$(offered --align '')"
expect "the beginning of a word" 'checkerboard' "$(offered --background c)"
expect "the presets" "$presets" "$(offered --preset '')"
expect "a preset's beginning" 'gold' "$(offered --preset g | grep gold)"
expect "files" $'look.json' "$(offered --style lo)"
expect "files for -o" $'lines.txt' "$(offered -o li)"
expect "nothing for a number" '' "$(offered --size '')"
[[ $shell != bash ]] || expect "words behind =" 'right' "$(offered --align = r)"
