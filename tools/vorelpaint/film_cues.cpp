#include "film_cues.h"

#include <algorithm>
#include <filesystem>
#include <new>

#include "error.h"
#include "painting.h"
#include "path_ending.h"
#include "style_file.h"
#include "subtitle_reader.h"

namespace vorelpaint {
namespace {

namespace fs = std::filesystem;

using vorelstyle::Style;
using voreltext::Anchor;
using voreltext::Box;
using voreltext::Canvas;
using voreltext::Image;

constexpr const char* kNoLook = "none";
constexpr const char* kUsualPreset = "subtitle";
const std::string kCommonLook;  ///< the name of the look of all cues that have no other

bool isFile(const std::string& look) {
    return vorelstyle::isSameWord(endingOf(look), "json") || look.find('/') != std::string::npos;
}

Style commonStyle(const Options& options) {
    const bool isChosen = options.inlineStyle || options.preset || options.style;
    return isChosen ? chosenStyle(options) : loadStyle(findPreset(kUsualPreset));
}

bool hasName(const Cue& cue, const std::string& name) {
    return std::find(cue.names.begin(), cue.names.end(), name) != cue.names.end();
}

void noteUnusedNames(const FilmOptions& film, const std::vector<Cue>& cues, const Note& note) {
    for (const CueStyle& style : film.cueStyles) {
        const bool isUsed = std::any_of(cues.begin(), cues.end(),
                                        [&](const Cue& cue) { return hasName(cue, style.name); });
        if (!isUsed) note("no cue is named " + inQuotes(style.name) + ", as a --cue-style is");
    }
}

Box movedBy(const Box& box, int x, int y) {
    return {box.left + x, box.top + y, box.right + x, box.bottom + y};
}

/// What of a box, grown by the effects' margins, lies in a frame; empty boxes are all zeros.
Box areaOf(const Box& ink, const voreltext::Margins& margins, const voreltext::CanvasRequest& frame) {
    const Box area{std::max(ink.left - margins.left, 0), std::max(ink.top - margins.top, 0),
                   std::min(ink.right + margins.right, *frame.width),
                   std::min(ink.bottom + margins.bottom, *frame.height)};
    return area.isEmpty() ? Box{} : area;
}

bool growsDownwards(Anchor anchor) {
    return anchor == Anchor::topLeft || anchor == Anchor::top || anchor == Anchor::topRight;
}

}  // namespace

float PlacedCue::opacityAt(double ms, const FilmOptions& film) const {
    double opacity = 1;
    const double since = ms - static_cast<double>(cue.startMs);
    const double until = static_cast<double>(cue.endMs) - ms;
    if (film.fadeInMs > 0) opacity = std::min(opacity, since / film.fadeInMs);
    if (film.fadeOutMs > 0) opacity = std::min(opacity, until / film.fadeOutMs);
    return static_cast<float>(std::max(opacity, 0.0));
}

FilmCues::FilmCues(const Options& options, const FrameRate& rate) : mOptions(options), mRate(rate) {
    const std::vector<Cue> cues = readSubtitles(options.film.subtitles.value());
    addStyles();
    noteUnusedNames(options.film, cues, mNotes.taker());
    for (const Cue& cue : cues)
        add(cue);
    if (mCues.empty()) {
        throw ToolError("nothing to show: " + inQuotes(*options.film.subtitles) +
                        " has no cue that is seen");
    }
    if (options.strict) mNotes.refuse();
}

int64_t FilmCues::frameCount() const {
    int64_t count = 0;
    for (const PlacedCue& placed : mCues)
        count = std::max(count, placed.endFrame);
    return count;
}

Box FilmCues::rows() const {
    Box painted;
    for (const PlacedCue& placed : mCues)
        painted.grow(placed.area);
    const int bottom = std::max((painted.bottom + 1) / 2 * 2, 2);
    return {0, painted.top / 2 * 2, *mOptions.canvas.width, std::min(bottom, *mOptions.canvas.height)};
}

Image FilmCues::paint(const PlacedCue& placed, Workbench& bench) const {
    const Composition composition = composed(optionsOf(placed.cue, placed.look), bench);
    const Box& area = placed.area;
    const Canvas canvas{area.width(), area.height(), composition.canvas().x - area.left,
                        composition.canvas().y + placed.down - area.top};
    return voreltext::paint(composition.looks().layers(), composition.text().layout(), canvas);
}

void FilmCues::addStyles() {
    mStyles.emplace(kCommonLook, commonStyle(mOptions));
    for (const CueStyle& style : mOptions.film.cueStyles) {
        if (style.look == kNoLook || mStyles.count(style.look) != 0) continue;
        const fs::path file = isFile(style.look) ? fs::path(style.look) : findPreset(style.look);
        mStyles.emplace(style.look, loadStyle(file));
    }
}

std::string FilmCues::lookOf(const Cue& cue) const {
    for (const CueStyle& style : mOptions.film.cueStyles) {
        if (hasName(cue, style.name)) return style.look;
    }
    return kCommonLook;
}

Options FilmCues::optionsOf(const Cue& cue, const std::string& look) const {
    Options options = mOptions;
    options.text = cue.text;
    options.inlineStyle = mStyles.at(look);
    return options;
}

std::string FilmCues::placeOf(const Cue& cue) const {
    return inQuotes(*mOptions.film.subtitles) + ", line " + std::to_string(cue.line) + ": ";
}

void FilmCues::add(const Cue& cue) {
    const std::string look = lookOf(cue);
    if (look == kNoLook) return;
    try {
        place(cue, look);
    } catch (const InvisibleText&) {
        return;
    } catch (const std::bad_alloc&) {
        throw;
    } catch (const std::exception& error) {
        throw ToolError(placeOf(cue) + error.what());
    }
}

void FilmCues::place(const Cue& cue, const std::string& look) {
    const Note note = [&](const std::string& line) {
        if (mNoted.insert(line).second) mNotes.taker()(placeOf(cue) + line);
    };
    const Composition composition = composed(optionsOf(cue, look), mBench);
    composition.notes().giveTo(note);
    const Canvas& canvas = composition.canvas();
    const Box box = movedBy(composition.text().box(), canvas.x, canvas.y);
    const int down = roomFor(box, cue);
    const Box ink = movedBy(composition.text().layout().inkBox(), canvas.x, canvas.y + down);
    mCues.push_back({cue, look, movedBy(box, 0, down),
                     areaOf(ink, composition.margins(), mOptions.canvas), down,
                     mRate.framesBefore(cue.startMs), mRate.framesBefore(cue.endMs)});
    const PlacedCue& placed = mCues.back();
    const bool isCut = placed.box.top < 0 || placed.box.bottom > *mOptions.canvas.height;
    if (down != 0 && isCut) note("there is no room left beside the cues that are seen with it");
    if (placed.firstFrame == placed.endFrame) note("the cue falls between two frames and is not seen");
}

/// How far a box moves so that it overlaps none of the cues that are still seen when its own starts.
int FilmCues::roomFor(const Box& box, const Cue& cue) {
    const auto hasEnded = [&](size_t index) { return mCues[index].cue.endMs <= cue.startMs; };
    mSeen.erase(std::remove_if(mSeen.begin(), mSeen.end(), hasEnded), mSeen.end());
    const bool downwards = growsDownwards(mOptions.canvas.anchor);
    int down = 0;
    for (bool moved = true; moved;) {
        moved = false;
        for (const size_t index : mSeen) {
            const Box& other = mCues[index].box;
            if (box.top + down >= other.bottom || box.bottom + down <= other.top) continue;
            down = downwards ? other.bottom - box.top : other.top - box.bottom;
            moved = true;
        }
    }
    mSeen.push_back(mCues.size());
    return down;
}

}  // namespace vorelpaint
