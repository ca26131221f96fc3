#pragma once

#include "VFBitmap.h"

/// The parameter records of the effects, one class per kind.
///
/// VFEffect's add-calls (VFEffect.h) build them from clamped arguments; build one by hand only to
/// pass numbers past the add-calls' limits through VFEffect::addEffect. A record owns nothing that
/// it points to: stop arrays and pattern bitmaps stay the caller's, and a core that is given a
/// record makes its own deep copy.
///
/// Units: angles in degrees, sizes and distances in pixels, opacities and stop positions 0 to 1.
/// Unless said otherwise a constructor stores its arguments unchanged. A NaN scale stays NaN.
namespace VFontEffect {

/// Base of all records. The virtual operations stand in slot order.
class VF_API VFProperty {
  public:
    VFProperty(unsigned int color, float opacity);       ///< stores both
    VFProperty(const VFProperty&) = default;             ///< copies pointers, not what they point to
    VFProperty& operator=(const VFProperty&) = default;  ///< copies pointers, not what they point to
    virtual ~VFProperty();

    /// How many characters toSequentialChar may write, its closing zero byte not counted. Glows and
    /// gradients reserve 10 characters a stop and write 9; the pattern reserves 17 and writes none.
    virtual int getSequentialCharLength() = 0;

    /// Writes the record's fragment of the cache key at *cursor, a zero byte after it, and moves
    /// *cursor to that zero byte. The buffer must hold getSequentialCharLength() + 1 bytes.
    /// Every character but the leading type letter has its top bit set, so a fragment contains no
    /// zero byte. Returns true; false, with nothing written, when `cursor` or *cursor is null.
    virtual bool toSequentialChar(char** cursor) = 0;

    unsigned int mColor;  ///< 0xAARRGGBB; premultiplied for text, shadows and stroke, else straight
    float mOpacity;       ///< 0 to 1
};

/// The plain fill of the text. Colour premultiplied.
class VF_API VFTextProperty : public VFProperty {
  public:
    VFTextProperty(unsigned int color, float opacity);  ///< stores both
    int getSequentialCharLength() override;
    bool toSequentialChar(char** cursor) override;
};

/// A shadow behind the text. The angle is stored as given. Colour premultiplied.
class VF_API VFOuterShadowProperty : public VFProperty {
  public:
    /// Stores its arguments.
    VFOuterShadowProperty(float angle, float distance, float size, unsigned int color, float opacity);
    int getSequentialCharLength() override;
    bool toSequentialChar(char** cursor) override;

    float mAngle;     ///< where the light comes from: 0 from the right, 90 from above
    float mDistance;  ///< how far the shadow is moved
    float mSize;      ///< blur radius
};

/// A shadow that falls into the text. Colour premultiplied.
class VF_API VFInnerShadowProperty : public VFProperty {
  public:
    /// The angle is cut to whole degrees and reduced by 360, keeping its sign.
    VFInnerShadowProperty(float angle, float distance, float size, unsigned int color, float opacity);
    int getSequentialCharLength() override;
    bool toSequentialChar(char** cursor) override;

    float mAngle;     ///< where the light comes from: 0 from the right, 90 from above
    float mDistance;  ///< how far the shadow is moved
    float mSize;      ///< blur radius
};

/// An outline. Colour premultiplied.
class VF_API VFStrokeProperty : public VFProperty {
  public:
    /// Stores its arguments.
    VFStrokeProperty(float size, unsigned int color, float opacity, int strokeStyle, int position);
    int getSequentialCharLength() override;
    bool toSequentialChar(char** cursor) override;

    float mSize;       ///< width of the outline
    int mStrokeStyle;  ///< part of the cache key only
    int mPosition;     ///< 0 centred on the edge, 1 outside, any other value inside
};

/// A halo around the text. Colour straight.
class VF_API VFOuterGlowProperty : public VFProperty {
  public:
    /// Stores its arguments, the stops by their address.
    VFOuterGlowProperty(float size, unsigned int color, float opacity, int count, VFGradient* gradient);
    int getSequentialCharLength() override;
    bool toSequentialChar(char** cursor) override;

    float mSize;            ///< reach of the halo
    int mGradientCount;     ///< stops in mGradient; with none the glow has the one colour mColor
    VFGradient* mGradient;  ///< not owned; may be null
};

/// A glow that starts at the edges of the text and reaches inwards. Colour straight.
class VF_API VFInnerGlowProperty : public VFProperty {
  public:
    /// Stores its arguments, the stops by their address.
    VFInnerGlowProperty(float size, unsigned int color, float opacity, int count, VFGradient* gradient);
    int getSequentialCharLength() override;
    bool toSequentialChar(char** cursor) override;

    float mSize;            ///< reach of the glow
    int mGradientCount;     ///< stops in mGradient; with none the glow has the one colour mColor
    VFGradient* mGradient;  ///< not owned; may be null
};

/// A ramp across the text. mColor is 0; the stops carry straight colours.
class VF_API VFLinearGradientProperty : public VFProperty {
  public:
    /// The angle is cut to whole degrees and reduced by 360, keeping its sign; the scale is
    /// clamped to 0..2.
    VFLinearGradientProperty(float angle, float scale, float opacity, int count, VFGradient* gradient);
    int getSequentialCharLength() override;
    bool toSequentialChar(char** cursor) override;

    float mAngle;           ///< 0 runs to the right, 90 upwards
    float mScale;           ///< length of the ramp in lengths of the text box; below 0.1 draws nothing
    int mGradientCount;     ///< stops in mGradient
    VFGradient* mGradient;  ///< not owned; may be null
};

/// A ramp from the centre of the text outwards. mColor is 0; the stops carry straight colours.
class VF_API VFRadialGradientProperty : public VFProperty {
  public:
    /// Angle and scale as for the linear gradient; the angle is carried but not drawn.
    VFRadialGradientProperty(float angle, float scale, float opacity, int count, VFGradient* gradient);
    int getSequentialCharLength() override;
    bool toSequentialChar(char** cursor) override;

    float mAngle;           ///< part of the cache key only
    float mScale;           ///< radius in half widths of the text box; below 0.1 draws nothing
    int mGradientCount;     ///< stops in mGradient
    VFGradient* mGradient;  ///< not owned; may be null
};

/// Parameters of a bevel. No core paints it: VFEffect::addBevelText always returns 0xFFFFFFFF.
class VF_API VFBevelProperty : public VFProperty {
  public:
    /// mColor is 0; depth is clamped to 0..10 and soften to 0..16; the angle is cut to whole degrees
    /// and reduced by 360, the altitude by 90, both keeping their sign.
    VFBevelProperty(int style, float size, float depth, int technique, int direction, int soften,
                    float opacity, float angle, float altitude, unsigned int highlightColor,
                    float highlightOpacity, unsigned int shadowColor, float shadowOpacity);
    int getSequentialCharLength() override;
    bool toSequentialChar(char** cursor) override;

    int mStyle;                    ///< opaque, but that 1 lies inside the glyph
    float mSize;                   ///< pixels
    float mDepth;                  ///< 0 to 10
    int mTechnique;                ///< opaque
    int mDirection;                ///< opaque
    int mSoften;                   ///< pixels, 0 to 16
    float mAngle;                  ///< of the light, whole degrees within one turn
    float mAltitude;               ///< of the light, whole degrees within a quarter turn
    unsigned int mHighlightColor;  ///< straight
    float mHighlightOpacity;       ///< 0 to 1
    unsigned int mShadowColor;     ///< straight
    float mShadowOpacity;          ///< 0 to 1
};

/// Parameters of an emboss. No core paints it: VFEffect::addEmbossText always returns 0xFFFFFFFF.
class VF_API VFEmbossProperty : public VFProperty {
  public:
    /// Clamps and reduces as the bevel record does.
    VFEmbossProperty(int style, float size, float depth, int technique, int direction, int soften,
                     float opacity, float angle, float altitude, unsigned int highlightColor,
                     float highlightOpacity, unsigned int shadowColor, float shadowOpacity);
    int getSequentialCharLength() override;
    bool toSequentialChar(char** cursor) override;

    int mStyle;                    ///< opaque
    float mSize;                   ///< pixels
    float mDepth;                  ///< 0 to 10
    int mTechnique;                ///< opaque
    int mDirection;                ///< opaque
    int mSoften;                   ///< pixels, 0 to 16
    float mAngle;                  ///< of the light, whole degrees within one turn
    float mAltitude;               ///< of the light, whole degrees within a quarter turn
    unsigned int mHighlightColor;  ///< straight
    float mHighlightOpacity;       ///< 0 to 1
    unsigned int mShadowColor;     ///< straight
    float mShadowOpacity;          ///< 0 to 1
};

/// A bitmap tiled over the text. mColor is 0.
class VF_API VFPatternProperty : public VFProperty {
  public:
    /// The scale is clamped to 0..10.
    VFPatternProperty(VFBitmap* pattern, float scale, float opacity);

    /// 17, although toSequentialChar writes nothing: a pattern leaves no trace in the cache key.
    int getSequentialCharLength() override;

    /// Writes nothing and leaves *cursor where it was.
    bool toSequentialChar(char** cursor) override;

    VFBitmap* mPattern;  ///< not owned; 4 bytes per pixel in memory order A, R, G, B; may be null
    float mScale;        ///< output pixels per pattern pixel; below 0.1 draws nothing
};

}  // namespace VFontEffect
