#include "film.h"

#include <algorithm>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "child_program.h"
#include "compose/background.h"
#include "console.h"
#include "crew.h"
#include "error.h"
#include "file_io.h"
#include "film_clip.h"
#include "film_cues.h"
#include "film_form.h"
#include "film_frames.h"
#include "film_report.h"
#include "film_request.h"
#include "new_file.h"
#include "numbered_name.h"
#include "numbered_pictures.h"
#include "png_writer.h"
#include "progress.h"
#include "ranges.h"
#include "spread_colours.h"

namespace vorelpaint {
namespace {

using voreltext::Box;
using voreltext::CanvasRequest;
using voreltext::Image;
using Bytes = std::vector<uint8_t>;

constexpr int kUsualWidth = 1920;
constexpr int kUsualHeight = 1080;

void noteOddities(const Options& options, const Clip& clip, const FilmCues& cues, const Note& note) {
    if (!clip.hasSquarePixels) {
        note("the clip's pixels are not square: the text is stretched with its pictures");
    }
    if (!clip.durationMs) return;
    const auto isBehind = [&](const PlacedCue& placed) {
        return placed.cue.startMs >= *clip.durationMs;
    };
    const auto behind = std::count_if(cues.all().begin(), cues.all().end(), isBehind);
    if (behind == 0) return;
    note(std::to_string(behind) + " of " + std::to_string(cues.all().size()) +
         " cues start behind the end of the clip " + inQuotes(*options.film.over));
}

FrameRate rateOf(const Options& options, const std::optional<Clip>& clip) {
    if (options.film.rate) return *options.film.rate;
    if (!clip) return kFilmRate;
    if (clip->rate) return *clip->rate;
    throw ToolError(inQuotes(*options.film.over) + " has no steady frame rate of " +
                    spelled(kFrameRates) + "; give one by --fps");
}

Options sized(const Options& asked, const std::optional<Clip>& clip) {
    Options options = asked;
    if (clip) {
        options.canvas.width = clip->width;
        options.canvas.height = clip->height;
    }
    if (!options.canvas.width) options.canvas.width = kUsualWidth;
    if (!options.canvas.height) options.canvas.height = kUsualHeight;
    const int side = std::min(*options.canvas.width, *options.canvas.height);
    if (options.film.scalesSize) options.size = std::max(side / 18, 1);
    if (options.film.scalesMargin) options.canvas.margin = side / 20;
    return options;
}

/// A film that is set, and not yet painted.
struct Film {
    explicit Film(const Options& asked)
        : clip(asked.film.over ? std::optional<Clip>(readClip(*asked.film.over)) : std::nullopt),
          options(sized(asked, clip)),
          rate(rateOf(options, clip)),
          cues(options, rate) {
        if (clip) noteOddities(options, *clip, cues, notes.taker());
        if (options.strict) notes.refuse();
    }

    std::optional<Clip> clip;
    Options options;
    FrameRate rate;
    FilmCues cues;
    HeldNotes notes;  ///< of the clip
};

// --- raw frames -------------------------------------------------------------------------------------

void writeRaw(const Film& film) {
    FilmFrames frames(film.options, film.cues, film.rate, threadsFor(film.options));
    const int64_t count = film.cues.frameCount();
    writeFile(*film.options.output, [&](std::FILE* file) {
        Progress progress("frames", static_cast<size_t>(count));
        for (int64_t frame = 0; frame < count; ++frame) {
            frames.advanceTo(frame);
            writeAll(file, frames.picture().pixels);
            progress.advance();
        }
    });
}

// --- pictures ---------------------------------------------------------------------------------------

/// A picture like the one before, and one without any cue, is not encoded anew. Frames are laid here,
/// one after the other, and encoded on threads.
void writeFramePictures(const Film& film, const NumberedName& name) {
    const int64_t count = film.cues.frameCount();
    FilmFrames frames(film.options, film.cues, film.rate, 1);
    NumberedPictures pictures(name, threadsFor(film.options), "frames", static_cast<size_t>(count));
    std::shared_ptr<NumberedPictures::File> blank;
    std::shared_ptr<NumberedPictures::File> seen;
    for (int64_t frame = 0; frame < count; ++frame) {
        const bool isNew = frames.advanceTo(frame);
        auto& file = frames.isBlank() ? blank : seen;
        if (frames.isBlank() ? blank == nullptr : isNew) {
            file = pictures.add(frame, [&film, picture = frames.picture()](Workbench&) {
                return encodedPng(picture, film.options.png);
            });
        } else {
            pictures.repeat(frame, file);
        }
    }
    pictures.finish();
}

Bytes pictureOf(const Film& film, const PlacedCue& cue, Workbench& bench) {
    const CanvasRequest& size = film.options.canvas;
    Image frame = voreltext::transparentImage(*size.width, *size.height);
    if (!cue.area.isEmpty()) layOver(frame, film.cues.paint(cue, bench), cue.area.left, cue.area.top);
    layOn(frame, film.options.background);
    return encodedPng(frame, film.options.png);
}

void writeCuePictures(const Film& film, const NumberedName& name) {
    NumberedPictures pictures(name, threadsFor(film.options), "cues", film.cues.all().size());
    int64_t number = 0;
    for (const PlacedCue& cue : film.cues.all())
        pictures.add(++number, [&](Workbench& bench) { return pictureOf(film, cue, bench); });
    pictures.finish();
}

// --- films of ffmpeg --------------------------------------------------------------------------------

/// Without a clip beneath, the rows that no cue paints have to be sent only where they have a colour.
Box rowsToSend(const Film& film) {
    const Options& options = film.options;
    const Box whole{0, 0, *options.canvas.width, *options.canvas.height};
    return film.clip || isTransparentFilm(options) ? film.cues.rows() : whole;
}

/// Behind the last cue comes a frame without any, as long as the clip goes on.
int64_t framesToSend(const Film& film) {
    const int64_t count = film.cues.frameCount();
    if (!film.clip) return count;
    if (!film.clip->durationMs) return count + 1;
    return std::min(count, film.rate.framesBefore(*film.clip->durationMs)) + 1;
}

/// The rows of a frame as ffmpeg is to take them.
Image rowsIn(const Image& picture, const FilmPlan& plan) {
    constexpr int kReach = 8;  // as far as a block of a codec is wide
    const auto row = [&](int y) {
        return picture.pixels.begin() + static_cast<std::ptrdiff_t>(offsetOf(picture, 0, y));
    };
    Image rows{picture.width, plan.rows.height(), {row(plan.rows.top), row(plan.rows.bottom)}};
    if (mixesColours(plan)) spreadColours(rows, kReach);
    return rows;
}

/// ffmpeg may close its input early, when the clip ends before the cues do.
void feed(const Film& film, const FilmPlan& plan, ChildProgram& ffmpeg) {
    FilmFrames frames(film.options, film.cues, film.rate, threadsFor(film.options));
    const int64_t count = framesToSend(film);
    Progress progress("frames", static_cast<size_t>(count));
    Image rows;
    for (int64_t frame = 0; frame < count; ++frame) {
        if (frames.advanceTo(frame)) rows = rowsIn(frames.picture(), plan);
        if (!ffmpeg.write(rows.pixels.data(), rows.pixels.size())) break;
        progress.advance();
    }
}

FilmPlan planOf(const Film& film) {
    const Options& options = film.options;
    const FilmCodec& codec = filmCodec(*options.output, options.film.codec, isTransparentFilm(options));
    const bool isOdd = *options.canvas.width % 2 != 0 || *options.canvas.height % 2 != 0;
    if (codec.needsEvenSides && isOdd) {
        throw ToolError(std::string("the sides of a film in ") + codec.name + " are even; these are " +
                        std::to_string(*options.canvas.width) + " x " +
                        std::to_string(*options.canvas.height));
    }
    return {*options.output,
            codec,
            isTransparentFilm(options),
            film.rate,
            rowsToSend(film),
            *options.canvas.height,
            options.film.over.value_or(""),
            film.clip};
}

/// In version 5.1 ffmpeg ends as if all were well when there is no room for the end of a file.
const std::vector<std::string>& unfinishedFile() {
    static const std::vector<std::string> faults{"Error writing trailer", "Error closing file"};
    return faults;
}

void writeFilm(const Film& film) {
    const std::string& output = *film.options.output;
    const FilmPlan plan = planOf(film);
    NewFile file(followLinks(output));
    ChildProgram ffmpeg(ffmpegWords(plan), ChildProgram::Stream::input, ::fileno(file.get()));
    feed(film, plan, ffmpeg);
    try {
        ffmpeg.finish(unfinishedFile());
    } catch (const ToolError& error) {
        throw ToolError("cannot write " + inQuotes(output) + ": " + error.what());
    }
    file.finish();
}

void write(const Film& film) {
    const std::string& output = *film.options.output;
    switch (filmKindOf(output)) {
        case FilmKind::raw:
            return writeRaw(film);
        case FilmKind::file:
            return writeFilm(film);
        case FilmKind::pictures:
            break;
    }
    const NumberedName name = NumberedName::parse(output).value();
    if (film.options.film.pictureOf == PictureOf::cue) return writeCuePictures(film, name);
    writeFramePictures(film, name);
}

}  // namespace

void makeFilm(const Options& options, const Note& note) {
    const Film film(options);
    if (options.output) write(film);
    if (options.report) print(filmReport(film.options, film.cues));
    film.cues.notes().giveTo(note);
    film.notes.giveTo(note);
}

}  // namespace vorelpaint
