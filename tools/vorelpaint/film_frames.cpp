#include "film_frames.h"

#include <algorithm>

#include "compose/background.h"

namespace vorelpaint {
namespace {

using voreltext::Image;

void clearRows(Image& image, const voreltext::Box& rows) {
    const auto row = [&](int y) {
        return image.pixels.begin() + static_cast<std::ptrdiff_t>(offsetOf(image, 0, y));
    };
    std::fill(row(rows.top), row(rows.bottom), uint8_t{0});
}

bool isEverSeen(const PlacedCue& placed) {
    return placed.firstFrame < placed.endFrame && !placed.area.isEmpty();
}

}  // namespace

FilmFrames::FilmFrames(const Options& options, const FilmCues& cues, const FrameRate& rate, int threads)
    : mOptions(options),
      mCues(cues),
      mRate(rate),
      mRows(cues.rows()),
      mPicture(voreltext::transparentImage(*options.canvas.width, *options.canvas.height)),
      mCrew(threads) {
    layOn(mPicture, options.background);
}

bool FilmFrames::advanceTo(int64_t frame) {
    Seen seen = seenAt(frame);
    const bool isSame = mIsBegun && seen == mSeen;
    mIsBegun = true;
    if (isSame) return false;
    mSeen = std::move(seen);
    compose();
    return true;
}

void FilmFrames::paintAhead() {
    const std::vector<PlacedCue>& all = mCues.all();
    for (; mNextAhead < all.size() && !mCrew.isFull(); ++mNextAhead) {
        const PlacedCue& placed = all[mNextAhead];
        if (!isEverSeen(placed)) continue;
        mAhead.push_back(std::make_shared<Image>());
        mCrew.give([this, &placed, picture = mAhead.back()](Workbench& bench) {
            *picture = mCues.paint(placed, bench);
        });
    }
}

/// The first one that was given.
Image FilmFrames::takePainted() {
    paintAhead();
    mCrew.take();
    Image picture = std::move(*mAhead.front());
    mAhead.pop_front();
    paintAhead();
    return picture;
}

void FilmFrames::beginCues(int64_t frame) {
    const std::vector<PlacedCue>& all = mCues.all();
    for (; mNext < all.size() && all[mNext].firstFrame <= frame; ++mNext) {
        if (isEverSeen(all[mNext])) mPainted.emplace(mNext, takePainted());
    }
}

FilmFrames::Seen FilmFrames::seenAt(int64_t frame) {
    beginCues(frame);
    Seen seen;
    for (auto each = mPainted.begin(); each != mPainted.end();) {
        const PlacedCue& placed = mCues.all()[each->first];
        if (placed.endFrame <= frame) {
            each = mPainted.erase(each);
            continue;
        }
        const float opacity = placed.opacityAt(mRate.startMs(frame), mOptions.film);
        if (opacity > 0) seen.emplace_back(each->first, opacity);
        ++each;
    }
    return seen;
}

/// Only the rows that cues paint are ever touched.
void FilmFrames::compose() {
    clearRows(mPicture, mRows);
    for (const auto& [cue, opacity] : mSeen) {
        const voreltext::Box& area = mCues.all()[cue].area;
        if (opacity < 1) {
            Image faded = mPainted.at(cue);
            fade(faded, opacity);
            layOver(mPicture, faded, area.left, area.top);
        } else {
            layOver(mPicture, mPainted.at(cue), area.left, area.top);
        }
    }
    layOn(mPicture, mOptions.background, mRows.top, mRows.bottom);
}

}  // namespace vorelpaint
