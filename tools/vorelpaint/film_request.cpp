#include "film_request.h"

#include <cerrno>
#include <filesystem>

#include "error.h"
#include "file_io.h"
#include "film_form.h"
#include "numbered_name.h"

namespace vorelpaint {
namespace {

void checkFilmOutput(const Options& options) {
    const FilmOptions& film = options.film;
    const FilmKind kind = filmKindOf(*options.output);
    if (options.report && isStandardOutput(*options.output)) {
        throw ToolError("standard output cannot take both the film and what is printed");
    }
    if (kind == FilmKind::pictures && !NumberedName::parse(*options.output)) {
        throw ToolError(inQuotes(*options.output) +
                        " names one picture; those of a film are numbered, as by frame_%05d.png");
    }
    if (kind != FilmKind::pictures && film.pictureOf == PictureOf::cue) {
        throw ToolError("a picture of each cue needs a numbered name, such as cue_%03d.png");
    }
    if (kind != FilmKind::file && (film.over || film.codec)) {
        throw ToolError(std::string(film.over ? "--over" : "--codec") +
                        " needs a film: end the output's name with .mp4, .mov, .mkv or .webm");
    }
    std::error_code ignored;
    if (std::filesystem::is_directory(*options.output, ignored)) {
        errno = EISDIR;
        failWithErrno("cannot write " + inQuotes(*options.output));
    }
    if (kind == FilmKind::file) filmCodec(*options.output, film.codec, isTransparentFilm(options));
}

}  // namespace

bool isTransparentFilm(const Options& options) {
    return !options.film.over && options.background.kind == Background::Kind::transparent;
}

void takeFilmDefaults(Options& options, const std::function<bool(std::string_view)>& isGiven) {
    if (!isGiven("align")) options.align = voreltext::Align::center;
    if (!isGiven("anchor")) options.canvas.anchor = voreltext::Anchor::bottom;
    if (!isGiven("fit")) options.fit = Fit::wrap;
    if (!isGiven("box")) options.box = TextBox::line;
    options.film.scalesSize = !isGiven("size");
    options.film.scalesMargin = !isGiven("margin");
}

void checkFilm(const Options& options) {
    if (!options.output && !options.report) {
        throw ToolError("nowhere to show the subtitles: give -o FILE, or -o - for raw frames");
    }
    if (options.output) checkFilmOutput(options);
}

}  // namespace vorelpaint
