#!/usr/bin/env bash
# Builds the fuzz targets with clang, libFuzzer, AddressSanitizer and UndefinedBehaviorSanitizer and
# runs them, as many at a time as there are cores. Installs what it needs on Debian (as root).
#
#     scripts/fuzz.sh 60                              every target for a minute
#     scripts/fuzz.sh 3600 fuzz_blender fuzz_style    some of them for an hour
#     scripts/fuzz.sh --merge                         adds to the committed corpus what new inputs reach
#     scripts/fuzz.sh --coverage [committed]          the lines of the library that inputs reach, by room
#
# New inputs are kept in build/fuzz/corpus, inputs that end a target in build/fuzz/findings; replay one
# with build/fuzz/tests/fuzz/TARGET FILE, or without a fuzzer in any build with TARGET_replay FILE.
# Ends with 1 when there is a finding. VOREL_FUZZ_JOBS says how many targets run at a time.
#
# The coverage is that of the committed inputs and of those in build/fuzz/corpus, or of the former alone,
# in a build of clang's source coverage, at every level of the CPU (scripts/fuzz_coverage.py). Ends with 1
# below 99 of 100 lines.
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh

usage() { sed -n '2,/^set/s/^# \{0,1\}//p' "$0" >&2; exit 2; }
[[ ${1:-} =~ ^([1-9][0-9]*|--merge|--coverage)$ ]] || usage
seconds=$1
shift
all_targets=(fuzz_effect_set fuzz_differential fuzz_blender fuzz_capi fuzz_style fuzz_job fuzz_subtitles fuzz_text)
targets=("$@")
[[ $# -gt 0 ]] || targets=("${all_targets[@]}")

packages=(cmake ninja-build g++ clang-14 libclang-rt-14-dev llvm-14 pkg-config libgtest-dev
    libraqm-dev libfreetype-dev libfribidi-dev libharfbuzz-dev libunibreak-dev libfontconfig-dev
    libpng-dev libdeflate-dev nlohmann-json3-dev libcli11-dev fonts-dejavu-core android-liblog-dev)

if [[ $seconds = --coverage ]]; then
    [[ $# -eq 0 || $* = committed ]] || usage
    need_packages "${packages[@]}" python3
    cmake --preset coverage > /dev/null
    cmake --build --preset coverage -- --quiet
    profiles=build/coverage/profiles
    rm -rf "$profiles"
    mkdir -p "$profiles"
    for target in "${all_targets[@]}"; do
        inputs=("tests/fuzz/corpus/$target")
        [[ $# -gt 0 || ! -d build/fuzz/corpus/$target ]] || inputs+=("build/fuzz/corpus/$target")
        LLVM_PROFILE_FILE=$profiles/$target.profraw \
            build/coverage/tests/fuzz/"${target}_replay" "${inputs[@]}" 2> "$profiles/$target.log" ||
            { tail -n 3 "$profiles/$target.log" >&2; exit 1; }
    done
    llvm-profdata-14 merge -sparse "$profiles"/*.profraw -o "$profiles/all.profdata"
    llvm-cov-14 export build/coverage/libvoreleffect_tested.so \
        -instr-profile "$profiles/all.profdata" > "$profiles/export.json"
    exec python3 -B scripts/fuzz_coverage.py "$profiles/export.json" tests/fuzz/unreached.txt
fi

for target in "${targets[@]}"; do
    [[ -f tests/fuzz/$target.cpp ]] || { echo "no such target: $target" >&2; exit 2; }
done

need_packages "${packages[@]}"

jobs=${VOREL_FUZZ_JOBS:-$(nproc)}
cmake --preset fuzz > /dev/null
cmake --build --preset fuzz -- --quiet -j "$jobs"

export ASAN_SYMBOLIZER_PATH=/usr/bin/llvm-symbolizer-14
logs=build/fuzz/logs
mkdir -p "$logs"

# Longest input of a target: style files, jobs and subtitles are text, the others are short programs of calls.
longest() { [[ $1 = fuzz_style || $1 = fuzz_job || $1 = fuzz_subtitles ]] && echo 4096 || echo 1024; }

if [[ $seconds = --merge ]]; then
    for target in "${targets[@]}"; do
        mkdir -p "build/fuzz/corpus/$target"
        build/fuzz/tests/fuzz/"$target" -merge=1 -max_len="$(longest "$target")" \
            "tests/fuzz/corpus/$target" "build/fuzz/corpus/$target" 2> "$logs/$target.merge.log"
        echo "$target: $(find "tests/fuzz/corpus/$target" -type f | wc -l) committed inputs"
    done
    exit
fi

fuzz() {
    local target=$1 options=()
    local corpus=build/fuzz/corpus/$target findings=build/fuzz/findings/$target
    mkdir -p "$corpus" "$findings"
    [[ ! -f tests/fuzz/${target#fuzz_}.dict ]] || options=(-dict="tests/fuzz/${target#fuzz_}.dict")
    build/fuzz/tests/fuzz/"$target" -max_total_time="$seconds" -max_len="$(longest "$target")" \
        -timeout=10 -report_slow_units=2 -rss_limit_mb=2048 -print_final_stats=1 \
        -artifact_prefix="$findings/" "${options[@]}" \
        "$corpus" "tests/fuzz/corpus/$target" > "$logs/$target.log" 2>&1
}

started=$logs/started
touch "$started"
declare -A failed=()
declare -A running=()
reap() {
    local pid status=0
    wait -n -p pid "${!running[@]}" || status=$?
    [[ $status -eq 0 ]] || failed[${running[$pid]}]=$status
    unset "running[$pid]"
}
for target in "${targets[@]}"; do
    [[ ${#running[@]} -lt $jobs ]] || reap
    fuzz "$target" &
    running[$!]=$target
done
while [[ ${#running[@]} -gt 0 ]]; do reap; done

printf '%-20s %12s %10s %10s  %s\n' target executions coverage features findings
findings=0
for target in "${targets[@]}"; do
    log=$logs/$target.log
    executions=$(sed -n 's/^stat::number_of_executed_units: *//p' "$log")
    # "#123 DONE cov: 456 ft: 789 ..."; a finding ends the run before such a line.
    coverage=$(sed -n 's/.* cov: \([0-9]*\).*/\1/p' "$log" | tail -n 1)
    features=$(sed -n 's/.* ft: \([0-9]*\).*/\1/p' "$log" | tail -n 1)
    mapfile -t artifacts < <(find "build/fuzz/findings/$target" -type f -newer "$started" | sort)
    printf '%-20s %12s %10s %10s  %s\n' "$target" "${executions:--}" "${coverage:--}" \
        "${features:--}" "${#artifacts[@]}"
    for artifact in "${artifacts[@]}"; do
        echo "    $artifact"
    done
    if [[ ${#artifacts[@]} -gt 0 || -n ${failed[$target]:-} ]]; then
        findings=1
        grep -E -m 3 'ERROR|runtime error|differs|^SUMMARY' "$log" | sed 's/^/    /' || true
        echo "    log: $log"
    fi
done
exit "$findings"
