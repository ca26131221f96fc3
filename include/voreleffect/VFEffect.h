#pragma once

#include <vector>

#include "VFBitmap.h"
#include "VFECore.h"
#include "VFProperty.h"

namespace VFontEffect {

/// A styled-text look and the painter of its runs.
///
/// Describe the look once with add-calls, then paint any number of runs (a line, a block, a glyph):
///
///     VFEffect look;
///     look.addOuterShadowText(135, 6, 8, 0x000000, 0.6f);
///     look.addStrokeText(4, 0xFFFFFF, 1, 0, 1);
///
///     char* key = look.getMapKey(0x3366CC);                 // registers the text fill
///     // margins: look.getLeftOffset() and its three sisters
///     look.initEffect(width, height);                       // makes the layers of the run
///     VFBitmap picture(width, height, 4);
///     look.setDstBitmap(&picture);
///     look.renderEffectLayer(x, y, &glyph);                 // once per glyph
///     look.doEffectPostProcessing();                        // every effect paints
///     look.compositeLayers(&picture);                       // merges the layers, ends the run
///     delete[] key;
///
/// The picture then holds premultiplied R, G, B, A bytes. It must be 32 bits per pixel and of the
/// size given to initEffect. With another number of bytes per pixel nothing is painted. With another
/// size what fits is painted; in layered mode (see initEffect) only of what lies inside the glyphs.
///
/// The effects lie in three groups, from the top: those inside the glyphs (inner shadow, inner glow,
/// gradients, pattern, inside stroke), the text fill, those beneath the text (outer shadow, outer glow,
/// outside stroke). Within a group the one that was added last lies on top, in a set that was not
/// planned before: see initEffect. A centred stroke, in both groups, lies over what was added before it.
///
/// The calls of a run come in this order. A destination that is set before initEffect is forgotten by
/// it, a glyph laid before it lost; after compositeLayers nothing is painted until the next initEffect.
///
/// One set is used by one thread at a time; separate sets may run on separate threads.
///
/// Effect type numbers: 1 outer shadow, 2 inner shadow, 3 outer glow, 4 inner glow, 5 bevel,
/// 6 emboss, 7 linear gradient, 8 radial gradient, 9 reserved, 10 stroke, 11 pattern, 12 text fill,
/// 13 none. Bevel, emboss and 9 have no core.
class VF_API VFEffect {
  public:
    VFEffect();  ///< without effects, at text opacity 1
    /// The same; the argument is not looked at. Beware: `VFEffect b(&a)` is an empty set; a copy of a is
    /// `VFEffect b(a)`.
    explicit VFEffect(void* ignored);

    /// Copies the look (each effect with its id and a deep copy of its record, the text opacity and
    /// colour, the id counter), not the bitmaps of a run.
    VFEffect(const VFEffect& other);
    VFEffect& operator=(const VFEffect&) = delete;
    virtual ~VFEffect();

    /// @name Add-calls: one per effect kind
    /// Each puts its effect into the set, or updates the one of its kind that is there, and returns
    /// the effect's id, or 0xFFFFFFFF when there is no core of that kind or no memory for one. An update
    /// that memory runs out for returns the id as well, and the effect stays as it was. No argument is
    /// refused: numbers are clamped to the ranges named here, a NaN to the lower end. Angles are cut to
    /// whole degrees and brought into 0..359, sizes and distances to whole pixels. The alpha byte of a
    /// colour is ignored; `opacity`, 0..1, takes its place. Arrays and bitmaps are copied.
    /// @{

    /// A shadow behind the text. Angle: where the light comes from, 0 from the right, 90 from above.
    /// Distance and size (blur radius) 0..100.
    unsigned int addOuterShadowText(float angle, float distance, float size, unsigned int color,
                                    float opacity);

    /// A shadow that falls into the text; arguments as for the outer shadow.
    unsigned int addInnerShadowText(float angle, float distance, float size, unsigned int color,
                                    float opacity);

    /// A halo around the text. Size 0..100. With 0 stops it has the one colour `color`; otherwise it
    /// runs through the stops from the text outwards. Count 0..256; stop positions are cut to
    /// hundredths, each stop's opacity is multiplied by `opacity`. A null array counts as no stops.
    unsigned int addOuterGlowText(float size, unsigned int color, float opacity, int count,
                                  VFGradient* gradient);

    /// A glow from the edges of the text inwards; arguments as for the outer glow.
    unsigned int addInnerGlowText(float size, unsigned int color, float opacity, int count,
                                  VFGradient* gradient);

    /// No core paints a bevel: returns 0xFFFFFFFF and leaves the list of effects as it is.
    unsigned int addBevelText(int style, float size, float depth, int technique, int direction,
                              int soften, float opacity, float angle, float altitude,
                              unsigned int highlightColor, float highlightOpacity,
                              unsigned int shadowColor, float shadowOpacity);

    /// No core paints an emboss: returns 0xFFFFFFFF and leaves the list of effects as it is.
    unsigned int addEmbossText(int style, float size, float depth, int technique, int direction,
                               int soften, float opacity, float angle, float altitude,
                               unsigned int highlightColor, float highlightOpacity,
                               unsigned int shadowColor, float shadowOpacity);

    /// A ramp across the text box. Angle 0 runs to the right, 90 upwards. Scale 0..2 is the length
    /// of the ramp in lengths of the box; below 0.1 nothing is drawn. Stops as for the outer glow,
    /// at least one.
    unsigned int addLinearGradientText(float angle, float scale, float opacity, int count,
                                       VFGradient* gradient);

    /// A ramp from the centre of the text box. Scale 0..2 is the radius in half widths of the box;
    /// below 0.1 nothing is drawn. Stops as for the outer glow, at least one.
    unsigned int addRadialGradientText(float scale, float opacity, int count, VFGradient* gradient);

    /// An outline of `size` pixels, 0..100. Position 0 centred on the edge, 1 outside, any other
    /// value inside. strokeStyle only enters the cache key.
    unsigned int addStrokeText(float size, unsigned int color, float opacity, int strokeStyle,
                               int position);

    /// A bitmap tiled over the text from the top left corner of its box. The bitmap has 4 bytes per
    /// pixel in memory order A, R, G, B, straight. Scale 0..10; below 0.1 nothing is drawn, nor for a
    /// bitmap that is null, has no pixels or another number of bytes per pixel.
    unsigned int addPatternText(VFBitmap* pattern, float scale, float opacity);

    /// The plain fill. Also called by getMapKey(color) with the text opacity.
    unsigned int addText(unsigned int color, float opacity);

    /// @}
    /// @name Registry
    /// @{

    /// Gives `property` (copied; null leaves the core without a new record) to the core of that
    /// type, made with this id if there is none; a negative id asks for the next of the counter. The
    /// record must be of the class that belongs to the type: nothing checks it. Returns the id of the
    /// core that holds it, or -1 when there is no core of that type or memory ran out.
    int addEffect(int id, int type, VFProperty* property);
    int addEffect(int type, VFProperty* property);  ///< addEffect(-1, type, property)

    /// Makes a core that is not in the list; the caller owns it. Null for a type without a core, or when
    /// memory ran out.
    [[nodiscard]] VFECore* createEffect(int id, int type, VFECore* ignored);

    int getNewEffectId();               ///< takes the next id from the counter
    VFECore* getEffect(int type);       ///< the core of that type, owned by the set, or null
    bool removeEffect(int id);          ///< destroys the core of that id; false if there is none
    void releaseEffect(VFECore* core);  ///< destroys a core that is in no list; null does nothing
    void releaseEffect();               ///< destroys every core and starts ids at 0 again
    void cleanAllEffect();              ///< the same as releaseEffect()
    void releaseBitmap();               ///< drops the layers of the run and the destination
    void cleanLayers();                 ///< does nothing
    bool hasEffects();                  ///< any core, or a text opacity below 1

    void setTextOpacity(float opacity);  ///< clamped to 0..1; below 1 selects layered mode
    float getTextOpacity();              ///< 0 to 1; 1 at the start
    void clearTextOpacity();  ///< 1 again; unlike setTextOpacity keeps the paint order as it is

    /// The glyph mask of the run, 1 byte per pixel, or null; owned by the set.
    VFBitmap* getSrcBitmap();
    /// Replaces the glyph mask; the set owns the new one (it must come from `new`), the caller the
    /// previous one.
    void setSrcBitmap(VFBitmap* mask);
    VFBitmap* getDstBitmap();                  ///< the destination of the run, or null
    void setDstBitmap(VFBitmap* destination);  ///< not owned; must live until compositeLayers

    /// @}
    /// @name One run
    /// @{

    /// Starts a run on layers of width x height pixels: chooses layered mode (text opacity below 1,
    /// or a centred stroke), makes the glyph mask and the outer layer, and puts the cores in paint
    /// order. Clears the destination, so setDstBitmap comes after it. Sizes below 0 count as 0.
    /// When one of the layers cannot be made nothing is drawn: getSrcBitmap() is null then or has no
    /// pixels, whichever layer it was.
    ///
    /// The paint order is worked out by reversing the list as it stands, whenever an add-call or a
    /// new text opacity came since the last time: a second run after such a call paints effects of
    /// one group in the opposite order.
    void initEffect(int width, int height);

    bool isUnderEffect(VFECore* core);  ///< painted beneath the text; false for null

    int getLeftOffset();    ///< pixels that the effects need left of the glyphs: leave them in the layer
    int getRightOffset();   ///< the same on the right
    int getTopOffset();     ///< the same above
    int getBottomOffset();  ///< the same below

    /// The box of the run's glyphs, which the effects paint around; owned by the set. It starts anew
    /// with the first glyph after doEffectPostProcessing: a run given up before that leaves its box to
    /// the next one, and a run without glyphs has the box of the last one.
    VFRect* getTextRect();

    /// Merges the coverage of `glyph` into the mask with its top left corner at (x, y), clipped, and
    /// grows the text box. Overlapping glyphs keep the larger coverage. A glyph whose buffer is null, or
    /// that has no width or height, leaves the mask and grows the box all the same.
    void renderEffectLayer(int x, int y, VFGlyph* glyph);

    /// Every effect paints once from the mask into the destination (or the outer layer).
    void doEffectPostProcessing();

    /// In layered mode merges the outer layer into `destination` by the glyph coverage; then, in
    /// every mode, drops the layers and ends the run. A destination that is null, not 4 bytes per
    /// pixel or of another size than the layers is left as it is.
    void compositeLayers(VFBitmap* destination);

    /// @}
    /// @name Cache key
    /// @{

    /// The look as a zero-terminated string of bytes, for a cache of painted runs: equal for two
    /// sets built by the same calls in the same order. The caller releases it with delete[]; null
    /// when memory runs out, or when records with absurd stop counts would make it longer than 2^28
    /// bytes. It follows the order of the list, which initEffect changes, so compare
    /// keys taken at the same point of the cycle. A pattern leaves no trace in it.
    [[nodiscard]] char* getMapKey();

    /// Registers the text fill in `color` (0xRRGGBB) at the text opacity, then the key.
    char* getMapKey(unsigned int color);
    /// @}

  private:
    std::vector<VFECore*> mEffects;
    VFBitmap* mSrcBitmap = nullptr;
    VFBitmap* mDstBitmap = nullptr;
    VFBitmap* mOuterLayer = nullptr;
    VFRect mTextRect;
    bool mResetTextRect = true;
    int mUseOuterLayer = 0;
    float mTextOpacity = 1.0F;
    unsigned int mTextColor = 0xFF000000U;  // kept with the look, not used for drawing
    int mNextEffectId = 0;
    unsigned char mTextAlpha = 255;  // likewise
    bool mOrdered = false;
};

}  // namespace VFontEffect
