#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "literal_cores.h"
#include "literal_image.h"

/// The effect set and its runs in plain loops over plain values: the second form of VFEffect, which
/// the real one is compared with.
namespace vorel_test::literal {

/// Effect type numbers.
enum Kind {
    kOuterShadow = 1,
    kInnerShadow = 2,
    kOuterGlow = 3,
    kInnerGlow = 4,
    kLinearGradient = 7,
    kRadialGradient = 8,
    kReserved = 9,
    kStroke = 10,
    kPattern = 11,
    kText = 12
};

/// A pattern: four bytes A, R, G, B per pixel, packed rows.
struct Tile {
    int width = 0, height = 0;
    std::vector<uint8_t> bytes;
};

/// One effect with its normalised parameters; a kind uses the fields that it has.
struct Effect {
    int kind = 0;
    int id = -1;
    uint32_t color = 0;
    float opacity = 0.0F;
    float angle = 0.0F;
    float distance = 0.0F;
    float size = 0.0F;
    float scale = 0.0F;
    int strokeStyle = 0;
    int position = 0;
    std::vector<Stop> stops;
    bool hasTile = false;
    Tile tile;
};

/// The fill of the text: the whole mask in one colour, beneath what is there.
void paintText(Picture& dst, const Mask& mask, bool useOuterLayer, uint32_t color);

/// One look and the layers of its current run. The calls are VFEffect's, of the same names.
class Engine {
  public:
    Engine() = default;

    /// Copies the look, not the run.
    Engine(const Engine& other);
    Engine& operator=(const Engine&) = delete;

    // The add-calls of VFEffect, with its arguments.
    unsigned addOuterShadowText(float angle, float distance, float size, uint32_t color, float opacity);
    unsigned addInnerShadowText(float angle, float distance, float size, uint32_t color, float opacity);
    unsigned addOuterGlowText(float size, uint32_t color, float opacity, int count, const Stop* stops);
    unsigned addInnerGlowText(float size, uint32_t color, float opacity, int count, const Stop* stops);
    unsigned addLinearGradientText(float angle, float scale, float opacity, int count,
                                   const Stop* stops);
    unsigned addRadialGradientText(float scale, float opacity, int count, const Stop* stops);
    unsigned addStrokeText(float size, uint32_t color, float opacity, int strokeStyle, int position);
    unsigned addPatternText(const Tile* tile, float scale, float opacity);
    unsigned addText(uint32_t color, float opacity);

    /// addBevelText and addEmbossText: no core, no effect.
    unsigned addKindWithoutCore();

    /// Puts a normalised effect into the set under `id`, or the next of the counter when negative.
    int addEffect(int id, const Effect& effect);

    const Effect* getEffect(int kind) const;
    bool removeEffect(int id);
    void releaseEffect();
    bool hasEffects() const;
    void setTextOpacity(float opacity);
    float getTextOpacity() const { return mTextOpacity; }
    void clearTextOpacity() { mTextOpacity = 1.0F; }

    void initEffect(int width, int height);
    bool isUnderEffect(const Effect& effect) const;
    void setDstBitmap(Picture* destination) { mDestination = destination; }
    void renderEffectLayer(int x, int y, const Mask* glyph);
    void doEffectPostProcessing();
    void compositeLayers(Picture& destination);
    Box textRect() const { return mTextRect; }
    bool hasMask() const { return mHasMask; }

    /// What the four offset queries return.
    Margins margins() const;

    /// The key up to its first zero byte.
    std::string getMapKey() const;
    std::string getMapKey(uint32_t color);

  private:
    void reorder();
    void paint(const Effect& effect, Picture* dst, Picture* sub);

    std::vector<Effect> mEffects;
    Mask mMask;
    bool mHasMask = false;
    Picture mOuterLayer;
    Picture* mDestination = nullptr;
    Box mTextRect;
    bool mResetTextRect = true;
    bool mUseOuterLayer = false;
    float mTextOpacity = 1.0F;
    int mNextId = 0;
    bool mOrdered = false;
};

}  // namespace vorel_test::literal
