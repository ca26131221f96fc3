#include "film_clip.h"

#include <algorithm>
#include <cmath>
#include <filesystem>
#include <map>
#include <utility>

#include "child_program.h"
#include "error.h"
#include "ranges.h"
#include "read_value.h"
#include "text/voreltext.h"

namespace vorelpaint {
namespace {

constexpr size_t kMaxToldBytes = size_t{1} << 20;
constexpr const char* kWhatIsAsked =
    "stream=codec_type,codec_name,width,height,pix_fmt,r_frame_rate,avg_frame_rate,sample_aspect_ratio,"
    "color_space,color_range:stream_disposition=attached_pic:stream_side_data=rotation:format=duration";

/// What ffprobe tells of a file or of one stream, by the last part of the keys.
using Told = std::map<std::string, std::string, std::less<>>;

std::string_view valueOf(const Told& told, std::string_view key) {
    const auto found = told.find(key);
    return found == told.end() ? std::string_view() : found->second;
}

std::string unquoted(std::string_view value) {
    const bool isQuoted = value.size() >= 2 && value.front() == '"' && value.back() == '"';
    return std::string(isQuoted ? value.substr(1, value.size() - 2) : value);
}

/// "streams.stream.1.width=320" becomes "width" of stream 1, "format.duration=2" that of the file, -1.
std::map<int, Told> streamsIn(std::string_view told) {
    constexpr std::string_view kStream = "streams.stream.";
    std::map<int, Told> streams;
    for (size_t at = 0; at < told.size();) {
        const size_t end = std::min(told.find('\n', at), told.size());
        std::string_view line = told.substr(at, end - at);
        at = end + 1;
        int stream = -1;
        if (line.substr(0, kStream.size()) == kStream) {
            line.remove_prefix(kStream.size());
            stream = numberIn<int>(line.substr(0, line.find('.'))).value_or(-1);
        }
        const size_t equals = line.find('=');
        if (equals == std::string_view::npos) continue;
        const std::string_view path = line.substr(0, equals);
        const std::string_view key = path.substr(path.rfind('.') + 1);  // npos + 1 is 0
        streams[stream].emplace(key, unquoted(line.substr(equals + 1)));
    }
    return streams;
}

int sideIn(const Told& stream, const char* key) {
    const std::optional<int> side = numberIn<int>(valueOf(stream, key));
    if (!side || !contains(kCanvasSide, *side)) {
        throw ToolError("its pictures are larger than " + std::to_string(kCanvasSide.high) +
                        " pixels, or of no known size");
    }
    return *side;
}

/// A camera held upright tells so in a side note, which FFmpeg heeds when it decodes.
bool isTurned(const Told& stream) {
    const std::optional<int> degrees = numberIn<int>(valueOf(stream, "rotation"));
    return degrees && *degrees % 180 != 0;
}

/// Where a clip does not say, players go by its height.
std::string matrixOf(const Told& stream, int height) {
    const std::string_view named = valueOf(stream, "color_space");
    if (named == "bt2020nc" || named == "bt2020c") return "bt2020";
    for (const char* known : {"bt709", "fcc", "bt470bg", "smpte170m", "smpte240m"}) {
        if (named == known) return known;
    }
    return height >= 720 ? "bt709" : "smpte170m";
}

/// The clip's pixels are to stay what they are where no cue is: of the formats that can be blended, the
/// first of which a part of the name tells. What has none of them, such as grey, is blended in the
/// first.
std::string blendingOf(std::string_view pixelFormat) {
    constexpr std::pair<std::string_view, const char*> kBlendings[]{
        {"420p1", "yuv420p10"}, {"p01", "yuv420p10"}, {"422p1", "yuv422p10"},
        {"422", "yuv422"},      {"444", "yuv444"},    {"gbr", "gbrp"},
        {"rgb", "gbrp"},        {"bgr", "gbrp"},      {"pal8", "gbrp"}};
    for (const auto& [part, blending] : kBlendings) {
        if (pixelFormat.find(part) != std::string_view::npos) return blending;
    }
    return "yuv420";
}

std::optional<int64_t> millisecondsIn(std::string_view seconds) {
    constexpr Limits<double> kDurations{0, 1e9};
    const std::optional<double> number = numberIn<double>(seconds);
    if (!number || !contains(kDurations, *number)) return std::nullopt;
    return static_cast<int64_t>(std::ceil(*number * 1000));
}

/// It is read twice: by ffprobe and by ffmpeg.
void requireFile(const std::string& path) {
    std::error_code fault;
    const std::filesystem::file_status status = std::filesystem::status(path, fault);
    if (std::filesystem::is_regular_file(status)) return;
    const bool isThere = std::filesystem::exists(status);
    throw ToolError("cannot read " + inQuotes(path) + ": " +
                    (isThere ? "a clip must be a file" : fault.message()));
}

Clip pictured(const Told& stream) {
    Clip clip;
    clip.width = sideIn(stream, "width");
    clip.height = sideIn(stream, "height");
    if (isTurned(stream)) std::swap(clip.width, clip.height);
    const std::string_view aspect = valueOf(stream, "sample_aspect_ratio");
    clip.hasSquarePixels = aspect.empty() || aspect == "1:1" || aspect == "0:1" || aspect == "N/A";
    clip.rate = parseFrameRate(valueOf(stream, "r_frame_rate"));
    if (!clip.rate) clip.rate = parseFrameRate(valueOf(stream, "avg_frame_rate"));
    clip.matrix = matrixOf(stream, clip.height);
    clip.isFullRange = valueOf(stream, "color_range") == "pc";
    clip.blending = blendingOf(valueOf(stream, "pix_fmt"));
    return clip;
}

}  // namespace

Clip clipIn(std::string_view told) {
    std::optional<Clip> clip;
    std::vector<std::string> audioCodecs;
    std::map<int, Told> streams = streamsIn(told);
    for (const auto& [index, stream] : streams) {
        const std::string_view kind = valueOf(stream, "codec_type");
        if (kind == "audio") audioCodecs.emplace_back(valueOf(stream, "codec_name"));
        const bool isCover = valueOf(stream, "attached_pic") == "1";
        if (kind == "video" && !isCover && !clip) clip = pictured(stream);
    }
    if (!clip) throw ToolError("it has no moving pictures");
    clip->audioCodecs = std::move(audioCodecs);
    clip->durationMs = millisecondsIn(valueOf(streams[-1], "duration"));
    return *clip;
}

Clip readClip(const std::string& path) {
    requireFile(path);
    ChildProgram program({"ffprobe", "-v", "error", "-protocol_whitelist", "file,pipe", "-of", "flat",
                          "-show_entries", kWhatIsAsked, fileUrl(path)},
                         ChildProgram::Stream::output);
    try {
        const std::string told = program.readAll(kMaxToldBytes);
        program.finish();
        return clipIn(told);
    } catch (const ToolError& error) {
        throw ToolError("cannot read " + inQuotes(path) + ": " + error.what());
    }
}

std::string fileUrl(const std::string& path) {
    return "file:" + path;
}

}  // namespace vorelpaint
