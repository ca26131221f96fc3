#pragma once

#include <cstddef>
#include <cstdint>
#include <deque>
#include <map>
#include <memory>
#include <utility>
#include <vector>

#include "crew.h"
#include "film_cues.h"
#include "film_rate.h"
#include "options.h"
#include "text/voreltext.h"

namespace vorelpaint {

/// The frames of a film, one after the other. A cue is painted once, a little before it is first seen,
/// and kept until it ends; a frame like the one before it is left as it is.
class FilmFrames {
  public:
    /// The cues must outlive it. The options have the frame's width and height. So many threads paint
    /// cues ahead.
    FilmFrames(const Options& options, const FilmCues& cues, const FrameRate& rate, int threads);

    /// Goes to a frame, which is not before the last one; whether its pixels may differ from those of
    /// the frame before, as those of the first one do.
    bool advanceTo(int64_t frame);

    /// The frame on its background, straight R, G, B, A.
    const voreltext::Image& picture() const { return mPicture; }

    /// Whether no cue is seen in it.
    bool isBlank() const { return mSeen.empty(); }

  private:
    using Seen = std::vector<std::pair<size_t, float>>;  ///< cues with their opacities

    void paintAhead();
    voreltext::Image takePainted();
    void beginCues(int64_t frame);
    Seen seenAt(int64_t frame);
    void compose();

    const Options& mOptions;
    const FilmCues& mCues;
    FrameRate mRate;
    voreltext::Box mRows;
    voreltext::Image mPicture;
    bool mIsBegun = false;
    Seen mSeen;
    size_t mNext = 0;                             ///< the first cue that has not begun
    std::map<size_t, voreltext::Image> mPainted;  ///< those that have begun and not ended

    size_t mNextAhead = 0;  ///< the first cue that was not given to be painted
    std::deque<std::shared_ptr<voreltext::Image>> mAhead;
    Crew mCrew;  ///< ends before what it works at
};

}  // namespace vorelpaint
