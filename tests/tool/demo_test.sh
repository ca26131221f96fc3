#!/usr/bin/env bash
# scripts/demo.sh helps, says that it builds, and keeps standard output for the path of the picture. In a
# tree of stand-ins, which build nothing: demo_test.sh SCRIPTS
set -euo pipefail
scripts=$(realpath "$1")
work=$(realpath "$(mktemp -d)")
trap 'rm -rf "$work"' EXIT
fail() { echo "$1" >&2; exit 1; }

mkdir -p "$work/scripts" "$work/programs"
cp "$scripts/demo.sh" "$scripts/packages.sh" "$scripts/quietly.sh" "$work/scripts"
cat > "$work/programs/dpkg-query" <<'END'
#!/usr/bin/env bash
printf installed
END
cat > "$work/programs/cmake" <<'END'
#!/usr/bin/env bash
if [[ $1 == -S ]]; then
    mkdir -p "$4/tools"
    printf '#!/usr/bin/env bash\nprintf "%%s\\n" "$@" > build/demo/arguments\n' > "$4/tools/vorelpaint"
    chmod +x "$4/tools/vorelpaint"
fi
echo "[1/2] at work on $*"
[[ ! -e fail ]]
END
chmod +x "$work/programs"/*
PATH="$work/programs:$PATH"
demo() { "$work/scripts/demo.sh" "$@" 2> "$work/err"; }

for option in -h --help; do
    [[ $(demo $option) == "usage: scripts/demo.sh [TEXT] [PRESET]"* ]] || fail "$option: no usage"
    [[ ! -s $work/err && ! -e $work/build ]] || fail "$option: does more than help"
done
status=0
said=$(demo --version) || status=$?
[[ $status -eq 2 && -z $said && $(cat "$work/err") == "demo.sh: no option --version;"* ]] || fail "takes any option"
status=0
demo Once upon "a time" || status=$?
[[ $status -eq 2 && $(wc -l < "$work/err") -eq 1 && ! -e $work/build ]] || fail "takes any number of words"

[[ $(demo Light ice) == "$work/build/demo/demo.png" ]] || fail "does not print the path of the picture alone"
[[ $(cat "$work/err") == "demo.sh: building vorelpaint in build/demo" ]] || fail "does not say that it builds in a plain line"
[[ $(tail -1 "$work/build/demo/arguments") == Light ]] || fail "paints another text"
grep -qx ice "$work/build/demo/arguments" || fail "paints another preset"

# On a terminal the build's own progress is seen.
seen=$(script -qec "$work/scripts/demo.sh" /dev/null < /dev/null)
grep -q '\[1/2\] at work on --build build/demo' <<< "$seen" || fail "shows no progress on a terminal: $seen"

touch "$work/fail"
status=0
said=$(demo) || status=$?
[[ $status -ne 0 && -z $said ]] || fail "goes on after a build that failed"
grep -q '\[1/2\] at work' "$work/err" || fail "does not show why the build failed"
