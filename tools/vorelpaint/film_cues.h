#pragma once

#include <cstdint>
#include <map>
#include <set>
#include <string>
#include <vector>

#include "compose/note.h"
#include "film_rate.h"
#include "options.h"
#include "style/vorelstyle.h"
#include "subtitle_cue.h"
#include "text/voreltext.h"
#include "workbench.h"

namespace vorelpaint {

/// A cue where and when it is seen.
struct PlacedCue {
    Cue cue;
    std::string look;     ///< by which FilmCues knows its style
    voreltext::Box box;   ///< of its text, in the frame; it may reach beyond it
    voreltext::Box area;  ///< of the frame: what its text and effects may paint; may be empty
    int down;             ///< how far it is moved to make room for others, in pixels
    int64_t firstFrame;
    int64_t endFrame;  ///< behind its last frame; the first one where it falls between two frames

    /// From 0 to 1: it rises and falls evenly within the times of fading, at a moment of the film.
    float opacityAt(double ms, const FilmOptions& film) const;
};

/// The cues of a film, set and placed, in the order of their starts.
class FilmCues {
  public:
    /// Sets every cue in a frame of the canvas's width and height, which must be given. Cues that are
    /// seen together do not overlap: the later one makes way, upwards, or downwards at an anchor at the
    /// top, and stays there. Throws ToolError with the place of a cue that cannot be painted, when
    /// nothing is left to show, and in a strict request for the first note.
    FilmCues(const Options& options, const FrameRate& rate);

    const HeldNotes& notes() const { return mNotes; }  ///< each line of a cue once, with its place
    const std::vector<PlacedCue>& all() const { return mCues; }
    int64_t frameCount() const;  ///< up to the end of the last cue

    /// The rows of the frame that any cue paints, and one at least. They begin and, but at the frame's
    /// edge, end evenly, as films of halved colour planes need them.
    voreltext::Box rows() const;

    /// The pixels of its area, premultiplied; on any thread, at a workbench of its own.
    voreltext::Image paint(const PlacedCue& placed, Workbench& bench) const;

  private:
    Options optionsOf(const Cue& cue, const std::string& look) const;
    void addStyles();
    std::string lookOf(const Cue& cue) const;
    std::string placeOf(const Cue& cue) const;
    void add(const Cue& cue);
    void place(const Cue& cue, const std::string& look);
    int roomFor(const voreltext::Box& box, const Cue& cue);

    Options mOptions;
    FrameRate mRate;
    Workbench mBench;
    HeldNotes mNotes;
    std::set<std::string> mNoted;  ///< what was said of a cue once
    std::map<std::string, vorelstyle::Style> mStyles;
    std::vector<PlacedCue> mCues;
    std::vector<size_t> mSeen;  ///< the placed cues that had not ended at the start of the last one
};

}  // namespace vorelpaint
