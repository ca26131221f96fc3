#!/usr/bin/env bash
# Builds the benchmarks with clang and prints what the library takes; docs/benchmarks.md explains it.
#
#     scripts/bench.sh [--peers] [--quick] [--filter REGEX] [--save FILE] [--compare FILE] [--counts]
#     scripts/bench.sh --document
#     scripts/bench.sh --costs [--quick] [--document]
#     scripts/bench.sh --hostile [--document]
#     scripts/bench.sh --growing [--document]
#
#     --peers          OpenCV, pixman, cairo, libass and FreeType's stroker on the same masks
#     --quick          fewer and shorter repetitions
#     --filter REGEX   only the rows that it finds; figures of a row end in its maker: /best, /literal ...;
#                      not with --costs
#     --save FILE      keeps the run
#     --compare FILE   adds the change against a kept run
#     --counts         instructions instead of time, under callgrind
#     --document       everything, into docs/benchmarks.md
#     --hostile        how many times as long as text masks take that are nothing like it: noise, ramps ...
#     --costs          the table for a reader in a hurry, beside Skia and OpenCV
#     --growing        what a pixel of a look takes in small and in large pictures
set -euo pipefail
invoked=$PWD
cd "$(dirname "$0")/.."
. scripts/packages.sh
. scripts/quietly.sh
. scripts/figures.sh
. scripts/skia.sh

peers=OFF times=yes counts='' document='' alone='' quick='' filter='' save='' compare=''
sampling=(--benchmark_min_time=0.02 --benchmark_repetitions=15)
while [[ $# -gt 0 ]]; do
    case $1 in
        --peers) peers=ON ;;
        --quick) quick=--quick sampling=(--benchmark_min_time=0.01 --benchmark_repetitions=5) ;;
        --counts) counts=yes times='' ;;
        --filter) filter=$2; shift ;;
        --save) save=$(cd "$invoked" && realpath -m "$2"); shift ;;
        --compare) compare=$(cd "$invoked" && realpath -e "$2"); shift ;;
        --document) document=docs/benchmarks.md ;;
        --costs | --hostile | --growing) alone=${1#--} ;;
        *) sed -n '2,/^set/{/^#/p}' "scripts/${0##*/}" >&2; exit 2 ;;
    esac
    shift
done
if [[ $alone == costs && -n $filter ]]; then
    echo 'scripts/bench.sh: --costs takes no --filter' >&2
    exit 2
fi
[[ -z $document || -n $alone ]] || peers=ON counts=yes

need_packages cmake ninja-build clang-14 pkg-config libbenchmark-dev libfreetype-dev fonts-dejavu-core python3
[[ -z $counts ]] || need_packages valgrind
need_peers() {
    need_packages libopencv-core-dev libopencv-imgproc-dev libpixman-1-dev libcairo2-dev libass-dev
}
[[ $peers == OFF ]] || need_peers
# Without one its column is empty.
if [[ $alone == costs ]]; then
    ! need_peers || peers=ON
    install_skia build/bench/node || true
fi

build=build/bench
cmake --preset bench -DVOREL_BENCH_PEERS="$peers" > /dev/null
cmake --build --preset bench -- --quiet

print_times() {
    local run=$build/run.json
    "$build/bench/voreleffect_bench" "${sampling[@]}" --benchmark_filter="${filter:-.}" \
        --benchmark_enable_random_interleaving=true --benchmark_report_aggregates_only=true \
        --benchmark_out="$run" --benchmark_out_format=json > "$build/run.log" 2>&1 ||
        { tail "$build/run.log" >&2; return 1; }
    [[ -z $save ]] || cp "$run" "$save"
    python3 bench/table.py "$run" ${compare:+--compare "$compare"}
    printf '\n### Peak working memory beside the layers (goal: at most 1.00 layers)\n\n'
    "$build/bench/voreleffect_memory"
}

# One run of each row, in the function that does nothing else.
print_counts() {
    local row level pixels instructions
    printf '\n### Instructions\n\n| %-36s | %-7s | %12s | %9s |\n' row level instructions 'per pixel'
    echo '| ------------------------------------ | ------- | -----------: | --------: |'
    "$build/bench/voreleffect_counts" --list "${filter:-TITLE160/R:(8|32|100)|growth|512x128|fill|look}" |
        while read -r row level pixels; do
            instructions=$(valgrind --tool=callgrind --callgrind-out-file=/dev/null \
                --toggle-collect=vorelCountedCall "$build/bench/voreleffect_counts" "$row" "$level" 2>&1 |
                sed -n 's/.*Collected : //p')
            printf '| %-36s | %-7s | %12d | %9s |\n' "$row" "$level" "$instructions" \
                "$(awk "BEGIN { printf \"%.2f\", $instructions / $pixels }")"
        done
}

print_all() {
    describe_run clang++-14
    [[ -z $times ]] || print_times
    [[ -z $counts ]] || print_counts
}

print_alone() {
    describe_run clang++-14
    echo
    if [[ $alone == costs ]]; then
        RIVALS_NODE=$build/node python3 -B bench/costs.py --programs "$build/bench" $quick
    else
        "$build/bench/voreleffect_$alone" ${filter:+"$filter"}
    fi
}

if [[ -n $alone ]]; then
    print_alone | tee "$build/$alone.md"
    [[ -z $document ]] || write_figures "$alone figures" "$build/$alone.md" "$document"
    exit
fi

if [[ -n $times ]]; then "$build/bench/voreleffect_bench" --check; fi
if [[ -z $document ]]; then
    print_all
    exit
fi

print_all > "$build/figures.md"
write_figures figures "$build/figures.md" "$document"
echo "$document"
