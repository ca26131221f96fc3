#pragma once

#include <memory>
#include <mutex>
#include <vector>

#include "compose/system/workbench.h"

namespace vorelpython {

/// Workbenches, which belong to one thread at a time: a call takes one, and gives it back. Those of
/// kMostKept threads are kept.
class Benches {
  public:
    static constexpr size_t kMostKept = 16;

    using Bench = std::unique_ptr<vorelcompose::Workbench>;

    Benches() { mKept.reserve(kMostKept); }

    Bench take() {
        const std::lock_guard<std::mutex> alone(mMutex);
        if (mKept.empty()) return std::make_unique<vorelcompose::Workbench>(mFonts);
        Bench bench = std::move(mKept.back());
        mKept.pop_back();
        return bench;
    }
    /// Takes no memory.
    void giveBack(Bench bench) {
        const std::lock_guard<std::mutex> alone(mMutex);
        if (mKept.size() < kMostKept) mKept.push_back(std::move(bench));
    }

  private:
    vorelcompose::SystemFontSource mFonts;
    std::mutex mMutex;
    std::vector<Bench> mKept;
};

}  // namespace vorelpython
