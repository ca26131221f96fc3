#!/usr/bin/env bash
# What help and manual of the program name is installed, and so is what the installed pages link to:
# installed_test.sh VORELPAINT PREFIX
set -euo pipefail
program=$1
prefix=$2
fail() { echo "$1" >&2; exit 1; }

help=$("$program" --help)
manual=$("$program" --man)
for text in "$help" "${manual//\\-/-}"; do
    mapfile -t named < <(grep -oE '(docs?|share|style)/[A-Za-z0-9/._-]*[A-Za-z0-9]' <<< "$text")
    [[ ${#named[@]} -ge 4 ]] || fail "only ${#named[@]} files are named"
    for path in "${named[@]}"; do
        [[ -e $prefix/$path ]] || fail "$path is named but not installed"
    done
done

pages=("$prefix"/share/doc/vorelpaint/*.md)
[[ ${#pages[@]} -eq 6 ]] || fail "not the six pages"
for page in "${pages[@]}"; do
    mapfile -t links < <(grep -oE '(\]\(|<img src=")[^)#"]+' "$page" | sed -E 's/^(\]\(|<img src=")//')
    [[ ${#links[@]} -ge 2 ]] || fail "$page: not the links that were counted"
    for link in "${links[@]}"; do
        [[ -e ${page%/*}/$link ]] || fail "$page links to $link, which is not installed"
    done
done
[[ -e $prefix/share/man/man1/vorelpaint.1 || -e $prefix/share/man/man1/vorelpaint.1.gz ]] || fail "no manual page"
