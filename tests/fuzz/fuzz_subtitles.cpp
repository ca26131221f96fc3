/// The first byte chooses a format, the rest is a subtitle file. Either it is read, with every cue in
/// its time and something to say, or it is refused with a ToolError of one line; nothing else may be
/// thrown.
#include <array>
#include <cstdint>
#include <string_view>

#include "demand.h"
#include "error.h"
#include "subtitle_reader.h"

namespace {

using namespace vorel_fuzz;
using namespace vorelpaint;

void require(const Cue& cue) {
    demand(cue.startMs >= 0 && cue.startMs < cue.endMs, "a cue runs backwards");
    demand(cue.endMs <= kLongestFilmMs, "a cue is too late");
    demand(!cue.text.empty() && cue.text.front() != '\n' && cue.text.back() != '\n',
           "a cue has blank ends");
    demand(cue.line > 0, "a cue has no line");
    for (const std::string& name : cue.names)
        demand(name.find('\n') == std::string::npos, "a name is not one line");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    constexpr std::array<const char*, 3> kFiles{"a.srt", "a.vtt", "a.ass"};
    if (size == 0) return 0;
    const std::string_view bytes(reinterpret_cast<const char*>(data) + 1, size - 1);
    try {
        int64_t before = 0;
        for (const Cue& cue : subtitlesIn(bytes, kFiles[data[0] % kFiles.size()])) {
            require(cue);
            demand(cue.startMs >= before, "cues are not in order");
            before = cue.startMs;
        }
    } catch (const ToolError& error) {
        demandLine(error.what());
    }
    return 0;
}
