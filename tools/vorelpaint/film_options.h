#pragma once

#include <optional>
#include <string>
#include <vector>

#include "film_rate.h"

namespace vorelpaint {

/// The look of the cues that have a name.
struct CueStyle {
    std::string name;
    std::string look;  ///< a preset, a style file, or "none": they are not shown
};

/// What a numbered name such as frame_%05d.png stands for a picture of.
enum class PictureOf { frame, cue };

/// What is asked of a film, beside its text's looks and its canvas.
struct FilmOptions {
    std::optional<std::string> subtitles;
    std::optional<std::string> over;
    std::optional<FrameRate> rate;  ///< without one that of the clip, else kFilmRate
    int fadeInMs = 0;
    int fadeOutMs = 0;
    std::vector<CueStyle> cueStyles;  ///< the first one that fits a cue counts
    std::optional<std::string> codec;
    PictureOf pictureOf = PictureOf::frame;
    bool scalesSize = false;  ///< the font's size follows the frame's; none was given
    bool scalesMargin = false;
};

constexpr FrameRate kFilmRate{30, 1};

}  // namespace vorelpaint
