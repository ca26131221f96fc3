#pragma once

#include <functional>
#include <memory>
#include <string>

#include "case.h"
#include "tests/support/literal_image.h"
#include "voreleffect/VFECore.h"
#include "workload.h"

/// One effect painted from a workload that stands in the middle of a layer.
namespace vorel_bench {

namespace literal = vorel_test::literal;

/// The box of a workload with `margin` pixels around it.
literal::Box boxOf(const Workload& workload, int margin);

/// The coverage of a layer of that margin.
literal::Mask layerMask(const Workload& workload, int margin);

/// A core of the library paints into a clear layer.
class CoreJob : public Job {
  public:
    using MakeCore = std::function<std::unique_ptr<VFontEffect::VFECore>()>;

    CoreJob(const Workload* workload, int margin, const MakeCore& makeCore);
    void reset() override;
    void paint() override { mCore->doPostProcessing(&mParams); }
    Bytes painted() const override;

  private:
    VFontEffect::VFBitmap mMask;
    VFontEffect::VFBitmap mLayer;
    VFontEffect::VFRect mText;
    VFontEffect::VFECore::ParamPostProcessing mParams;
    std::unique_ptr<VFontEffect::VFECore> mCore;
};

/// The literal form of a core paints into a clear layer.
class LiteralCoreJob : public Job {
  public:
    using Paint = std::function<void(literal::Picture&, const literal::Mask&, literal::Box)>;

    LiteralCoreJob(const Workload* workload, int margin, Paint paint);
    void reset() override;
    void paint() override { mPaint(mLayer, mMask, mText); }
    Bytes painted() const override { return {mLayer.bytes.data(), mLayer.bytes.size()}; }

  private:
    literal::Mask mMask;
    literal::Picture mLayer;
    literal::Box mText;
    Paint mPaint;
};

/// Makes a core of the class `Core` that holds `record`.
template <class Core, class Record>
CoreJob::MakeCore coreWith(Record record) {
    return [record]() mutable {
        auto core = std::make_unique<Core>();
        core->setProperty(&record);
        return core;
    };
}

/// The cores of a linear and a radial gradient along rampStops(), and of a pattern of tileBytes().
CoreJob::MakeCore linearFill();
CoreJob::MakeCore radialFill();
CoreJob::MakeCore patternFill();

/// The core and its literal form, in a layer whose margin is a little wider than their reach. A figure
/// is per pixel of the box grown by `reach`.
void addCoreCases(Cases& cases, const std::string& row, const Workload& workload, int reach,
                  const CoreJob::MakeCore& makeCore, const LiteralCoreJob::Paint& paintLiterally);

}  // namespace vorel_bench
