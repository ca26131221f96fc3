#include "progress.h"

#include <algorithm>
#include <utility>

#include "console.h"

namespace vorelpaint {
namespace {

constexpr size_t kBarWidth = 32;
/// Often enough for the eye; drawing costs next to nothing beside the work.
constexpr std::chrono::milliseconds kInterval{50};

}  // namespace

Progress::Progress(std::string noun, size_t total)
    : mNoun(std::move(noun)), mTotal(total), mNextDrawing(Clock::now() + kInterval) {
    showStatus(line(mDone, mTotal, mNoun));
}

Progress::~Progress() {
    showStatus("");
}

void Progress::advance() {
    ++mDone;
    const Clock::time_point now = Clock::now();
    if (now < mNextDrawing) return;
    mNextDrawing = now + kInterval;
    showStatus(line(mDone, mTotal, mNoun));
}

std::string Progress::line(size_t done, size_t total, const std::string& noun) {
    if (total == 0) return std::to_string(done) + " " + noun;
    const size_t filled = std::min(done, total) * kBarWidth / total;
    return "[" + std::string(filled, '#') + std::string(kBarWidth - filled, '-') + "] " +
           std::to_string(done) + " of " + std::to_string(total) + " " + noun;
}

}  // namespace vorelpaint
