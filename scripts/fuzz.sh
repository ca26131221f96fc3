#!/usr/bin/env bash
# Builds the fuzz targets with clang, libFuzzer, AddressSanitizer and UndefinedBehaviorSanitizer and
# runs them, as many at a time as there are cores. Installs what it needs on Debian (as root).
#
#     scripts/fuzz.sh 60                              every target for a minute
#     scripts/fuzz.sh 3600 fuzz_blender fuzz_style    some of them for an hour
#
# New inputs are kept in build/fuzz/corpus, inputs that end a target in build/fuzz/findings; replay one
# with build/fuzz/tests/fuzz/TARGET FILE, or without a fuzzer in any build with TARGET_replay FILE.
# Ends with 1 when there is a finding.
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh

usage() { sed -n '2,11s/^# \{0,1\}//p' "$0" >&2; exit 2; }
[[ ${1:-} =~ ^[1-9][0-9]*$ ]] || usage
seconds=$1
shift
targets=("$@")
[[ $# -gt 0 ]] || targets=(fuzz_effect_set fuzz_differential fuzz_blender fuzz_style)
for target in "${targets[@]}"; do
    [[ -f tests/fuzz/$target.cpp ]] || { echo "no such target: $target" >&2; exit 2; }
done

need_packages cmake ninja-build g++ clang-14 libclang-rt-14-dev llvm-14 pkg-config libgtest-dev \
    libraqm-dev libfreetype-dev libpng-dev libfontconfig-dev nlohmann-json3-dev libcli11-dev \
    fonts-dejavu-core android-liblog-dev

cmake --preset fuzz > /dev/null
cmake --build --preset fuzz -- --quiet -j "$(nproc)"

export ASAN_SYMBOLIZER_PATH=/usr/bin/llvm-symbolizer-14
logs=build/fuzz/logs
mkdir -p "$logs"

# Longest input of a target: a style file is text, the others are short programs of calls.
longest() { [[ $1 = fuzz_style ]] && echo 4096 || echo 1024; }

fuzz() {
    local target=$1 options=()
    local corpus=build/fuzz/corpus/$target findings=build/fuzz/findings/$target
    mkdir -p "$corpus" "$findings"
    [[ $target != fuzz_style ]] || options=(-dict=tests/fuzz/style.dict)
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
    [[ ${#running[@]} -lt $(nproc) ]] || reap
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
