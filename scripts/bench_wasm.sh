#!/usr/bin/env bash
# Measures the looks of docs/benchmarks.md as WebAssembly in node, at the level simd128 and at the scalar one,
# beside the native level of 16 bytes and beside the literal form as WebAssembly. Installs what it needs on
# Debian (as root).
#
#     scripts/bench_wasm.sh               prints the table
#     scripts/bench_wasm.sh --quick       one short turn: shows that all of it works, not how fast
#     scripts/bench_wasm.sh --document    writes it into docs/benchmarks.md
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
. scripts/quietly.sh
. scripts/figures.sh

need_packages cmake ninja-build clang-14 pkg-config libbenchmark-dev libfreetype-dev fonts-dejavu-core \
    clang-19 lld-19 llvm-19 libc++-19-dev-wasm32 libclang-rt-19-dev-wasm32 wasi-libc
command -v node > /dev/null || need_packages nodejs

turns=5 rounds=5
[[ ${1-} != --quick ]] || turns=1 rounds=1
quietly cmake --preset bench
quietly cmake --build --preset bench --target voreleffect_rows --target voreleffect_write_glyphs
quietly cmake --preset bench-wasm32
quietly cmake --build --preset bench-wasm32 --target voreleffect_rows voreleffect_module voreleffect-scalar_module

# Both paint the same glyphs, and take turns.
export VOREL_BENCH_GLYPHS=$PWD/build/bench-wasm32/glyphs
mkdir -p "$VOREL_BENCH_GLYPHS"
build/bench/bench/voreleffect_write_glyphs "$VOREL_BENCH_GLYPHS"
looks=(look/A look/B look/C look/D)
figures=build/bench-wasm32/figures
: > "$figures.txt"
for ((turn = 0; turn < turns; ++turn)); do
    build/bench/bench/voreleffect_rows "$rounds" "${looks[@]}" | sed 's/^/native /' >> "$figures.txt"
    node tests/wasm/run.mjs build/bench-wasm32/bench/voreleffect_rows.wasm "$rounds" "${looks[@]}" |
        sed 's/^/wasm /' >> "$figures.txt"
done

# The fastest call of all turns.
table() {
    echo "$(describe_run clang++-19) Node $(node --version); the native library by clang 14."
    echo
    awk '
        { key = $1 " " $2; id = key " " $3 }
        !($2 in seen) { seen[$2] = 1; rows[++count] = $2 }
        $1 == "native" && $3 != "scalar" && $3 != "literal" { level = $3 }
        !(id in best) || $4 < best[id] { best[id] = $4 }
        END {
            format = "| %-16s | %13s | %9s | %12s | %9s | %9s | %9s |\n"
            printf format, "us", "native " level, "simd128", "times native", "scalar", "literal", "L/simd128"
            printf "|%s|%s:|%s:|%s:|%s:|%s:|%s:|\n", "------------------", "--------------", "----------",
                   "-------------", "----------", "----------", "----------"
            for (i = 1; i <= count; ++i) {
                row = rows[i]
                native = best["native " row " " level]
                wasm = best["wasm " row " simd128"]
                literal = best["wasm " row " literal"]
                printf format, substr(row, 6), sprintf("%.1f", native), sprintf("%.1f", wasm),
                       sprintf("%.2f", wasm / native), sprintf("%.1f", best["wasm " row " scalar"]),
                       sprintf("%.1f", literal), sprintf("%.1f", literal / wasm)
            }
        }' "$figures.txt"
}

# The modules' KiB, plain and compressed.
sizes() {
    local module
    printf '\n| module | KiB | gzip |\n|---|---:|---:|\n'
    for module in build/bench-wasm32/bindings/js/module/*.wasm; do
        printf '| %s | %d | %d |\n' "${module##*/}" $(($(stat -c %s "$module") / 1024)) \
            $(($(gzip -9 -c "$module" | wc -c) / 1024))
    done
}

{ table; sizes; } > "$figures.md"
if [[ ${1-} == --document ]]; then
    write_figures 'WebAssembly figures' "$figures.md" docs/benchmarks.md
else
    cat "$figures.md"
fi
