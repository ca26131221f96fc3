#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "film_clip.h"
#include "film_rate.h"
#include "options.h"
#include "text/voreltext.h"

/// The files that films are made in, and what ffmpeg is told for each of them.
namespace vorelpaint {

/// What comes out of a film.
enum class FilmKind {
    raw,       ///< straight R, G, B, A, frame after frame with nothing between them
    pictures,  ///< numbered PNG files
    file,      ///< what ffmpeg makes
};

/// By the name of the output: "-", devices, pipes and .rgba are raw, .png are pictures, the endings of
/// containers files. Throws ToolError for any other name.
FilmKind filmKindOf(const std::string& output);

/// A way of writing frames that a container may hold.
struct FilmCodec {
    const char* name;
    std::vector<std::string_view> endings;  ///< of the containers that hold it
    std::vector<std::string> opaque;        ///< ffmpeg's words for it; none where it cannot be had
    std::vector<std::string> transparent;
    bool isYuv;  ///< colours are converted to luma and chroma
    bool needsEvenSides;
};

/// The words of --codec.
const std::vector<std::string>& filmCodecNames();

/// The codec that is asked for, or else the first that the container of this name holds. Throws
/// ToolError when it holds none such.
const FilmCodec& filmCodec(const std::string& output, const std::optional<std::string>& asked,
                           bool isTransparent);

/// A film that ffmpeg is to make.
struct FilmPlan {
    std::string output;
    const FilmCodec& codec;
    bool isTransparent;
    FrameRate rate;
    voreltext::Box rows;  ///< of the frame, as wide as it
    int height;           ///< of the frame
    std::string over;     ///< a clip's path, empty for none
    std::optional<Clip> clip;
};

/// Whether the colours of neighbouring pixels are mixed before their alpha counts.
bool mixesColours(const FilmPlan& plan);

/// What ffmpeg is run with: frames of `rows` alone come to its standard input, raw, and the film goes to
/// the file that it is given.
std::vector<std::string> ffmpegWords(const FilmPlan& plan);

}  // namespace vorelpaint
