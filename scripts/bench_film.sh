#!/usr/bin/env bash
# Measures how fast vorelpaint makes films of 1920 x 1080 pixels at 30 frames a second, on one core.
#
#     scripts/bench_film.sh [--document]
#
#     --document       the figures into docs/film.md
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
. scripts/figures.sh

case ${1-} in
    '' | --document) ;;
    *) sed -n '2,/^set/{/^#/p}' "scripts/${0##*/}" >&2; exit 2 ;;
esac

need_packages ffmpeg util-linux
scripts/demo.sh > /dev/null
vorelpaint=$PWD/build/demo/tools/vorelpaint
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
cd "$work"

# cues COUNT: one of two lines every two seconds, each of 1.8 seconds.
cues() {
    local i begin='%02d:%02d:%02d,%03d'
    for ((i = 0; i < $1; ++i)); do
        printf "%d\n$begin --> $begin\n%s\n%s\n\n" $((i + 1)) 0 $((i / 30)) $((2 * i % 60)) 0 \
            0 $((i / 30)) $((2 * i % 60 + 1)) 800 \
            "The light goes, the road is long ($i)," "and then we walk until it comes again."
    done
}
cues 300 > ten_minutes.srt
cues 30 > minute.srt
cues 5 > ten_seconds.srt
ffmpeg -nostdin -v error -f lavfi -i testsrc2=duration=10:size=1920x1080:rate=30 -c:v libx264 \
    -preset ultrafast -qp 10 clip.mp4

# seconds COMMAND...: the processor time that a command and its children take on one core, the best of three.
seconds() {
    local TIMEFORMAT='%U %S' best='' taken
    for _ in 1 2 3; do
        taken=$({ time taskset -c 0 "$@" > output; } 2>&1 | awk '{ print $1 + $2 }')
        [[ -n $best && $(awk "BEGIN { print ($best <= $taken) }") == 1 ]] || best=$taken
    done
    echo "$best"
}

# row WHAT FRAMES SECONDS
row() {
    awk -v what="$1" -v frames="$2" -v taken="$3" \
        'BEGIN { printf "| %s | %.2f | %.0f | %.1f |\n", what, taken, frames / taken, frames / 30 / taken }'
}

through_pipe() { "$vorelpaint" "$@" -o - | cat > /dev/null; }
export -f through_pipe
export vorelpaint
fades=(--fade-in 250 --fade-out 250)
model=$(sed -n 's/^model name[^:]*: //p' /proc/cpuinfo | head -n 1)
{
    echo "| 1920 x 1080 at 30 frames a second, one core of ${model:-this machine} | seconds | frames a second | times real time |"
    echo "|---|---|---|---|"
    for preset in subtitle neon; do
        row "ten minutes of \`$preset\`, made and written to /dev/null" 18000 \
            "$(seconds "$vorelpaint" --subtitles ten_minutes.srt --preset $preset -o /dev/null)"
        row "the same with fades of 250 ms" 18000 \
            "$(seconds "$vorelpaint" --subtitles ten_minutes.srt --preset $preset "${fades[@]}" -o /dev/null)"
    done
    row "a minute of \`subtitle\` with fades, through a pipe to \`cat\`" 1800 \
        "$(seconds bash -c 'through_pipe "$@"' - --subtitles minute.srt "${fades[@]}")"
    row "ten seconds burnt into a clip, H.264" 300 \
        "$(seconds "$vorelpaint" --subtitles ten_seconds.srt "${fades[@]}" --over clip.mp4 -o film.mp4)"
    row "the clip encoded in the same way without cues, by ffmpeg" 300 \
        "$(seconds ffmpeg -nostdin -v error -i clip.mp4 -c:v libx264 -preset medium -crf 18 -y plain.mp4)"
} > figures.md

if [[ -z ${1-} ]]; then
    cat figures.md
    exit
fi
cd "$OLDPWD"
write_figures figures "$work/figures.md" docs/film.md
