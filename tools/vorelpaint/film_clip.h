#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "film_rate.h"

namespace vorelpaint {

/// What is to be known of a clip that cues are laid over.
struct Clip {
    int width = 0;  ///< as it is seen, a turned one turned
    int height = 0;
    bool hasSquarePixels = true;
    std::optional<FrameRate> rate;      ///< nothing where it is not steady
    std::optional<int64_t> durationMs;  ///< nothing where the file does not tell
    std::string matrix;        ///< how FFmpeg's scaler names its way from RGB to its colours: "bt709"
    bool isFullRange = false;  ///< whether black is 0 and white 255, not 16 and 235
    std::string blending = "yuv420";  ///< what FFmpeg's overlay calls the nearest pixels that it blends
    std::vector<std::string> audioCodecs;  ///< as FFmpeg names them, one of each stream of sound
};

/// Asks ffprobe for the first stream of moving pictures, not of a cover, and all of sound. Throws
/// ToolError, naming the clip, when it cannot be read or has no pictures.
Clip readClip(const std::string& path);

/// The clip that ffprobe tells of in its "flat" form, a key and a value a line. Throws ToolError.
Clip clipIn(std::string_view told);

/// A file as FFmpeg is to be given it: never taken for an option, an address or a format by its name.
std::string fileUrl(const std::string& path);

}  // namespace vorelpaint
