#pragma once

#include <voreleffect/VFEffect.h>

#include <functional>
#include <vector>

namespace vorel_test {

/// A core of any type number that paints nothing of its own and records every call.
class FakeCore : public VFontEffect::VFECoreBase {
  public:
    explicit FakeCore(int style, VFontEffect::VFProperty* property = nullptr) : mProperty(property) {
        mEffectType = style;
    }

    ~FakeCore() override {
        if (destroyed != nullptr) ++*destroyed;
    }

    int initEffect(ParamInit* init) override {
        inits.push_back(*init);
        return 1;
    }

    int render(ParamRender* render) override {
        renders.push_back(*render);
        return 1;
    }

    void doPostProcessing(ParamPostProcessing* params) override {
        paints.push_back(*params);
        boxes.push_back(*params->textRect);
        if (sequence != nullptr) sequence->push_back(mEffectType);
        if (onPaint) onPaint(*params);
    }

    void setProperty(VFontEffect::VFProperty* property) override { mProperty = property; }
    VFontEffect::VFProperty* getProperty() override { return mProperty; }
    int getLeftOffset() override { return offsets.mLeft; }
    int getTopOffset() override { return offsets.mTop; }
    int getRightOffset() override { return offsets.mRight; }
    int getBottomOffset() override { return offsets.mBottom; }

    std::vector<ParamInit> inits;
    std::vector<ParamRender> renders;
    std::vector<ParamPostProcessing> paints;
    std::vector<VFontEffect::VFRect> boxes;  ///< the text box of each paint
    std::function<void(const ParamPostProcessing&)> onPaint;
    std::vector<int>* sequence = nullptr;  ///< gets the type number at each paint
    int* destroyed = nullptr;              ///< counts destructions
    VFontEffect::VFRect offsets;

  private:
    VFontEffect::VFProperty* mProperty;
};

/// The fields of an effect set that no accessor shows. Naming a private member is allowed in an
/// explicit instantiation, which hands the member pointer on through a friend.
namespace hidden {

template <class Field, typename Field::Member kMember>
struct Reveal {
    friend typename Field::Member reveal(Field) { return kMember; }
};

struct EffectList {
    using Member = std::vector<VFontEffect::VFECore*> VFontEffect::VFEffect::*;
    friend Member reveal(EffectList);
};
template struct Reveal<EffectList, &VFontEffect::VFEffect::mEffects>;

struct NextEffectId {
    using Member = int VFontEffect::VFEffect::*;
    friend Member reveal(NextEffectId);
};
template struct Reveal<NextEffectId, &VFontEffect::VFEffect::mNextEffectId>;

struct TextAlpha {
    using Member = unsigned char VFontEffect::VFEffect::*;
    friend Member reveal(TextAlpha);
};
template struct Reveal<TextAlpha, &VFontEffect::VFEffect::mTextAlpha>;

struct TextColor {
    using Member = unsigned int VFontEffect::VFEffect::*;
    friend Member reveal(TextColor);
};
template struct Reveal<TextColor, &VFontEffect::VFEffect::mTextColor>;

}  // namespace hidden

inline std::vector<VFontEffect::VFECore*>& effectsOf(VFontEffect::VFEffect& set) {
    return set.*reveal(hidden::EffectList());
}

inline int& nextEffectIdOf(VFontEffect::VFEffect& set) {
    return set.*reveal(hidden::NextEffectId());
}
inline unsigned char textAlphaOf(VFontEffect::VFEffect& set) {
    return set.*reveal(hidden::TextAlpha());
}
inline unsigned int textColorOf(VFontEffect::VFEffect& set) {
    return set.*reveal(hidden::TextColor());
}

/// Appends a fake core to the list of `set`, which owns it from then on.
inline FakeCore* insertCore(VFontEffect::VFEffect& set, int style,
                            VFontEffect::VFProperty* property = nullptr) {
    auto* core = new FakeCore(style, property);
    effectsOf(set).push_back(core);
    return core;
}

}  // namespace vorel_test
