#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "subtitle_cue.h"

/// Subtitle files, of which times, texts and names are read, not styles and places.
///
/// They are read here and not by FFmpeg, which a film is otherwise made with: its readers take what they
/// do not understand for text, or end there, and tell neither. In version 5.1 a WebVTT file ends at its
/// first STYLE block, misspelt times become a line of the cue before, and a cue that ends before it
/// starts lasts until the next one. What nobody was told of would be missed in the finished film. libass
/// reads one of the formats alone. Besides, pictures can so be painted without either.
namespace vorelpaint {

constexpr size_t kMaxSubtitleBytes = size_t{1} << 24;
constexpr size_t kMostCues = 100000;
constexpr int64_t kLongestFilmMs = int64_t{24} * 60 * 60 * 1000;

/// The cues of a SubRip (.srt), WebVTT (.vtt) or ASS file (.ass, .ssa) in UTF-8, in the order of their
/// starts, those of one start in that of the file. Left out are cues without a text and those that end
/// where they start. Throws ToolError or ComposeError, naming file and line, for what cannot be read,
/// and for times that run backwards or beyond kLongestFilmMs; it throws, too, when there is no cue, or
/// more than kMostCues.
///
/// A cue's names are, in WebVTT, its identifier, classes and voices; in ASS its style and who speaks.
std::vector<Cue> readSubtitles(const std::string& path);

/// The same of bytes, as if they were in a file of this name.
std::vector<Cue> subtitlesIn(std::string_view bytes, const std::string& path);

/// "00:01:02.500".
std::string timeName(int64_t ms);

}  // namespace vorelpaint
