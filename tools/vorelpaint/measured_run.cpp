#include "measured_run.h"

#include <algorithm>
#include <chrono>
#include <utility>

#include "memory_meter.h"

namespace vorelpaint {
namespace {

using vorelcompose::LookPlan;
using vorelcompose::SteppedRun;
using vorelstyle::Look;
using voreltext::Frame;
using voreltext::GlyphMask;
using voreltext::Image;
using Clock = std::chrono::steady_clock;

/// Calls `step` and returns what it takes.
template <typename Step>
Cost costOf(Step step) {
    const MemoryMeter meter;
    const Clock::time_point start = Clock::now();
    step();
    const std::chrono::duration<double, std::milli> time = Clock::now() - start;
    return {time.count(), meter.peak()};
}

/// The layers stay throughout; each effect gives its working memory back before the next begins.
Cost sumOf(const MeasuredRun& run) {
    Cost whole = run.glyphs;
    size_t mostWork = run.merge.bytes;
    for (const Cost& effect : run.effects) {
        whole.milliseconds += effect.milliseconds;
        mostWork = std::max(mostWork, effect.bytes);
    }
    whole.milliseconds += run.merge.milliseconds;
    whole.bytes += mostWork;
    return whole;
}

void add(Cost& cost, const Cost& other) {
    cost.milliseconds += other.milliseconds;
    cost.bytes = std::max(cost.bytes, other.bytes);
}

void add(MeasuredRun& run, const MeasuredRun& other) {
    add(run.glyphs, other.glyphs);
    for (size_t i = 0; i < run.effects.size(); ++i)
        add(run.effects[i], other.effects[i]);
    add(run.merge, other.merge);
    add(run.whole, other.whole);
}

/// Replaces the time that `part` names in the first run by the median of all.
template <typename Part>
void takeMedian(std::vector<MeasuredRun>& runs, Part part) {
    std::vector<double> times;
    times.reserve(runs.size());
    for (MeasuredRun& run : runs)
        times.push_back(part(run).milliseconds);
    const auto middle = times.begin() + static_cast<std::ptrdiff_t>(times.size() / 2);
    std::nth_element(times.begin(), middle, times.end());
    part(runs.front()).milliseconds = *middle;
}

}  // namespace

MeasuredRun measuredRun(const Look& look, const LookPlan& plan, const Frame& frame,
                        const std::vector<GlyphMask>& glyphs, Image* picture) {
    SteppedRun run(look, plan, frame);
    MeasuredRun measured;
    measured.glyphs = costOf([&] { run.draw(glyphs); });
    for (size_t i = 0; i < plan.effects.size(); ++i) {
        run.choose(i);
        measured.effects.push_back(costOf([&] { run.paintChosen(); }));
    }
    measured.merge = costOf([&] { run.merge(); });
    if (picture != nullptr) *picture = run.picture();
    measured.whole = sumOf(measured);
    return measured;
}

MeasuredRun measuredRuns(const Look& look, const LookPlan& plan, const std::vector<RunOfGlyphs>& runs) {
    MeasuredRun together = measuredRun(look, plan, runs.front().frame, runs.front().masks);
    for (size_t i = 1; i < runs.size(); ++i)
        add(together, measuredRun(look, plan, runs[i].frame, runs[i].masks));
    return together;
}

MeasuredRun medianOf(std::vector<MeasuredRun> runs) {
    takeMedian(runs, [](MeasuredRun& run) -> Cost& { return run.glyphs; });
    for (size_t i = 0; i < runs.front().effects.size(); ++i)
        takeMedian(runs, [i](MeasuredRun& run) -> Cost& { return run.effects[i]; });
    takeMedian(runs, [](MeasuredRun& run) -> Cost& { return run.merge; });
    takeMedian(runs, [](MeasuredRun& run) -> Cost& { return run.whole; });
    return std::move(runs.front());
}

}  // namespace vorelpaint
