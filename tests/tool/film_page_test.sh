#!/usr/bin/env bash
# The commands of the page of films work as printed, and what they make is what the page shows:
# film_page_test.sh VORELPAINT PAGE
set -euo pipefail
program=$(realpath "$1")
page=$(realpath "$2")
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
cd "$work"

# The blocks of a language, one behind the other.
blocks() { awk -v fence="\`\`\`$1" '$0 == "```" { inside = 0 } inside; $0 == fence { inside = 1 }' "$page"; }
fail() { echo "$1" >&2; exit 1; }

blocks srt > talk.srt
blocks vtt > talk.vtt
ffmpeg -nostdin -v error -f lavfi -i testsrc2=duration=2:size=320x180:rate=25 -f lavfi -i sine=duration=2 \
    -c:v libx264 -preset ultrafast -c:a aac clip.mp4
blocks sh > commands.sh
[[ $(grep -c '^vorelpaint' commands.sh) -eq 7 ]] || fail "the page has not the seven commands that were counted"
PATH="${program%/*}:$PATH" bash -e commands.sh

# is FILE WHAT...: the first stream of a film.
is() {
    local file=$1 told
    shift
    told=$(ffprobe -v error -select_streams v:0 -show_entries stream=codec_name,width,height,pix_fmt \
        -of compact=p=0:nk=1 "$file")
    [[ $told == "$*" ]] || fail "$file is $told, not $*"
}
is film.mp4 'h264|320|180|yuv420p'
is cues.mov 'prores|1920|1080|yuva444p12le'
is cues.webm 'vp9|640|360|yuv420p'
is cues2.mov 'qtrle|1920|1080|argb'
is card.mp4 'h264|1280|720|yuv420p'
blocks jsonl | diff - <(head -n 1 cues.jsonl) || fail "the page shows another report"
[[ $(wc -l < cues.jsonl) -eq 2 && -s cue_001.png && -s cue_002.png && ! -e cue_003.png ]] || fail "not two cues"
[[ $(find . -name 'frame_*.png' | wc -l) -eq 4 ]] || fail "not four frames"
cmp frame_01.png "${page%/*}/film-frame.png" || fail "run scripts/tool_pictures.sh"

# The fault that the page shows.
sed 's/00:00:01,000 --> 00:00:01,900/00:00:02,000 --> 00:00:01,000/' talk.srt > turned.srt && mv turned.srt talk.srt
"$program" --subtitles talk.srt -o no.mov 2> said && fail "a film of times that run backwards"
blocks text | diff - said || fail "the page shows another fault"
