#pragma once

#include "VFBitmap.h"
#include "VFProperty.h"

/// The effect cores: one class per effect kind, each painting its effect from the glyph mask.
///
/// VFEffect (VFEffect.h) makes, owns and drives them; a caller needs this header only to look at a
/// core that VFEffect::getEffect returned, or to drive one by hand.
namespace VFontEffect {

namespace internal {
class ShadowPainter;
}

/// The interface of an effect core. The virtual operations stand in slot order, the destructor first.
///
/// The cores of the library paint nothing when the parameters, the stored record or a bitmap or box
/// that they need are missing, when the text box is empty or leaves the mask, when a size is out of
/// all proportion (above 256 pixels), or when memory for their working buffers runs out.
class VF_API VFECore {
  public:
    /// What a run looks like, handed to initEffect.
    struct ParamInit {
        int width;          ///< width of the layers in pixels
        int height;         ///< height of the layers in pixels
        int useOuterLayer;  ///< 1 in layered mode, else 0
    };

    /// One glyph, handed to render.
    struct ParamRender {
        int x;                ///< left edge of the glyph in the layer
        int y;                ///< top edge of the glyph in the layer
        VFGlyph* glyph;       ///< the glyph just drawn into the mask; may be null
        VFBitmap* dstBitmap;  ///< the destination of the run; may be null
    };

    /// What a core paints from and into. The mask and the targets share size and coordinates.
    struct ParamPostProcessing {
        VFBitmap* dstBitmap;     ///< 4 bytes per pixel: the target of this core
        VFBitmap* srcBitmap;     ///< 1 byte per pixel: coverage of all glyphs of the run
        VFRect* textRect;        ///< box of the glyphs, inside the mask
        int useOuterLayer;       ///< 1 in layered mode, else 0
        VFBitmap* subDstBitmap;  ///< null, or a second target that gets the same paint
    };

    VFECore() = default;
    VFECore(const VFECore&) = delete;
    VFECore& operator=(const VFECore&) = delete;
    virtual ~VFECore();  // slots 0 and 1

    /// Called when a run starts. The result is not looked at.
    virtual int initEffect(ParamInit* init) = 0;  // slot 2

    /// Called after each glyph of the run. The result is not looked at.
    virtual int render(ParamRender* render) = 0;  // slot 3

    /// Paints the effect of the whole run from the mask into the target.
    virtual void doPostProcessing(ParamPostProcessing* params) = 0;  // slot 4

    /// Replaces the stored record by a deep copy of `property`, which must be of the core's own record
    /// class (nothing checks it) and stays the caller's. Null is ignored. If memory runs out the
    /// stored record stays.
    virtual void setProperty(VFProperty* property) = 0;  // slot 5

    /// The stored record, owned by the core; null before setProperty.
    virtual VFProperty* getProperty() = 0;  // slot 6

    virtual float getOpacity() = 0;     ///< slot 7: 1 in every core, the opacity is in the record
    virtual int getStyle() = 0;         ///< slot 8: the effect type number
    virtual int getLeftOffset() = 0;    ///< slot 9: pixels painted left of the glyph box
    virtual int getRightOffset() = 0;   ///< slot 10: pixels painted right of it
    virtual int getTopOffset() = 0;     ///< slot 11: pixels painted above it
    virtual int getBottomOffset() = 0;  ///< slot 12: pixels painted below it
    virtual void setId(int id) = 0;     ///< slot 13: the effect set assigns it
    virtual int getId() = 0;            ///< slot 14: -1 until one was assigned
    virtual int getOffset() = 0;        ///< slot 15: pixels painted beyond the box on every side
};

/// Defaults of every operation but the two accessors of the record.
class VF_API VFECoreBase : public VFECore {
  public:
    VFECoreBase();
    ~VFECoreBase() override;

    int initEffect(ParamInit* init) override;                     ///< returns 1
    int render(ParamRender* render) override;                     ///< returns 1
    void doPostProcessing(ParamPostProcessing* params) override;  ///< paints nothing
    float getOpacity() override;                                  ///< 1
    int getStyle() override;                                      ///< the effect type number
    int getLeftOffset() override;                                 ///< getOffset()
    int getRightOffset() override;                                ///< getOffset()
    int getTopOffset() override;                                  ///< getOffset()
    int getBottomOffset() override;                               ///< getOffset()
    void setId(int id) override;
    int getId() override;
    int getOffset() override;  ///< 0

  protected:
    int mEffectType;  ///< 13, no effect; each core sets its own
    int mId;          ///< -1 until the effect set assigned one
};

/// Type 12: the plain colour fill of the glyphs. Outside layered mode it also clips everything
/// painted before it to the glyph coverage.
class VF_API VFText : public VFECoreBase {
  public:
    VFText();
    ~VFText() override;
    void doPostProcessing(ParamPostProcessing* params) override;
    void setProperty(VFProperty* property) override;
    VFProperty* getProperty() override;

  private:
    VFTextProperty* mProperty;
};

/// Builds the anti-aliased disc that the stroke stamps: a square of D x D bytes, D = 2R + 1 with
/// R = trunc(radius + 0.5). A cell at distance d from the centre weighs 255 up to d = radius and
/// falls linearly to 0 at d = radius + 1.
///
/// Stores a buffer from malloc through `kernel` (release it with free) and returns D. When memory
/// runs out, D is above 8192, or `kernel` is null, nothing is stored; nothing is stored and 0 is
/// returned when D is below 1 or D * D does not fit in 31 bits.
VF_API int makeCircleKernel(unsigned char** kernel, float radius);

/// Type 10: an outline, centred on the edge, outside or inside of it.
class VF_API VFStroke : public VFECoreBase {
  public:
    /// The work of one dilation. All planes are packed bytes, owned by the caller.
    ///
    /// The source is the coverage mask with a border of zeros, the plane the result: pixel (x, y) of
    /// the source is pixel (x + radius, y + radius) of the plane.
    struct DilationWork {
        unsigned char* plane;         ///< planeWidth x planeHeight; starts as zeros; two for the centre
        const unsigned char* source;  ///< sourceWidth x sourceHeight coverage
        const unsigned char* kernel;  ///< kernelSide x kernelSide, from makeCircleKernel
        int sourceWidth;              ///< pixels per row of the source
        int sourceHeight;             ///< rows of the source
        int planeWidth;               ///< at least sourceWidth + 2 * radius
        int planeHeight;              ///< at least sourceHeight + 2 * radius
        int kernelSide;               ///< 2 * radius + 1
        int firstRow;                 ///< first source row to process
        int endRow;                   ///< one past the last source row to process
        int radius;                   ///< 0 or more
    };

    VFStroke();
    ~VFStroke() override;
    void doPostProcessing(ParamPostProcessing* params) override;
    void setProperty(VFProperty* property) override;
    VFProperty* getProperty() override;
    int getOffset() override;  ///< how far the outline reaches outside the glyph

    /// The dilation routines; `work` points at a DilationWork. Each stamps the source rows of the band
    /// into the plane and returns 1; 0, with nothing written, for an empty band, a null pointer or
    /// sizes that do not fit together. Bands may be processed in any order, but not at the same time
    /// when the planes are shared: neighbouring bands write the same rows.
    static int partalDTStrokeCenter(void* work);   ///< outside into plane 1, inside into plane 2
    static int partalDTStrokeOutside(void* work);  ///< grows the coverage
    static int partalDTStrokeInside(void* work);   ///< grows the inverse of the coverage

  private:
    VFStrokeProperty* mProperty;
};

/// Type 1: a blurred, moved shadow beneath the text.
class VF_API VFOuterShadow : public VFECoreBase {
  public:
    VFOuterShadow();
    ~VFOuterShadow() override;
    void doPostProcessing(ParamPostProcessing* params) override;
    void setProperty(VFProperty* property) override;
    VFProperty* getProperty() override;
    int getLeftOffset() override;  ///< reach of blur and move on this side; 0 without a record
    int getRightOffset() override;
    int getTopOffset() override;
    int getBottomOffset() override;

  private:
    friend class internal::ShadowPainter;  // the move is that of the last setProperty

    VFOuterShadowProperty* mProperty;
    int mOffsetX;
    int mOffsetY;
};

/// Type 2: the inverse of the blurred, moved glyph, over the whole text box. The text fill, or in
/// layered mode the composite, confines it to the glyph.
class VF_API VFInnerShadow : public VFECoreBase {
  public:
    VFInnerShadow();
    ~VFInnerShadow() override;
    void doPostProcessing(ParamPostProcessing* params) override;
    void setProperty(VFProperty* property) override;
    VFProperty* getProperty() override;
    int getOffset() override;  ///< 0

  private:
    VFInnerShadowProperty* mProperty;
};

/// Type 3: a halo around the text.
class VF_API VFOuterGlow : public VFECoreBase {
  public:
    VFOuterGlow();
    ~VFOuterGlow() override;
    void doPostProcessing(ParamPostProcessing* params) override;
    void setProperty(VFProperty* property) override;
    VFProperty* getProperty() override;
    int getOffset() override;  ///< the size of the glow, rounded; 0 without a record

    /// Fills `table` (257 straight colour words) with the colours from the text (entry 0) to the end
    /// of the glow (entry 256, always 0). The alpha fades from `fadeStart` (0..1 of the table) on.
    /// Curve 1 bends the ramp by a square root, 2 by a square, any other value leaves it straight.
    /// Without a record or with a size of 0 all entries are 0.
    void makeColorLUT(unsigned int* table, float fadeStart, int curve);

    /// Grows coverage in place, `passes` times: each inner pixel becomes a quarter of the sum of its
    /// 3 x 3 neighbourhood, at most 255. `mask` is packed, width x height; its outermost rows keep
    /// their values, its outermost columns become 0 in the rows between them. Nothing is done for a
    /// height of at most 2, fewer than 1 pass, or when memory runs out.
    void increaseByBoxFilter(unsigned char* mask, int passes, int width, int height);

  private:
    VFOuterGlowProperty* mProperty;
};

/// Type 4: a glow from the edges of the text inwards, over the whole text box and around it. The text
/// fill, or in layered mode the composite, confines it to the glyph.
class VF_API VFInnerGlow : public VFECoreBase {
  public:
    VFInnerGlow();
    ~VFInnerGlow() override;
    void doPostProcessing(ParamPostProcessing* params) override;
    void setProperty(VFProperty* property) override;
    VFProperty* getProperty() override;
    int getOffset() override;  ///< the size of the glow, rounded; 0 without a record

    void makeColorLUT(unsigned int* table, float fadeStart, int curve);  ///< as VFOuterGlow's
    void increaseByBoxFilter(unsigned char* mask, int passes, int width, int height);  ///< likewise

  private:
    VFInnerGlowProperty* mProperty;
};

/// Type 7: a ramp across the text box. Coverage gates the colour, it does not scale it.
class VF_API VFLinearGradient : public VFECoreBase {
  public:
    VFLinearGradient();
    ~VFLinearGradient() override;
    void doPostProcessing(ParamPostProcessing* params) override;
    void setProperty(VFProperty* property) override;
    VFProperty* getProperty() override;

  private:
    VFLinearGradientProperty* mProperty;
};

/// Type 8: a ramp from the centre of the text box, its radius measured by the width alone.
class VF_API VFRadialGradient : public VFECoreBase {
  public:
    VFRadialGradient();
    ~VFRadialGradient() override;
    void doPostProcessing(ParamPostProcessing* params) override;
    void setProperty(VFProperty* property) override;
    VFProperty* getProperty() override;

  private:
    VFRadialGradientProperty* mProperty;
};

/// Type 11: a bitmap tiled over the text, sampled bilinearly. Coverage gates it.
class VF_API VFPattern : public VFECoreBase {
  public:
    VFPattern();
    ~VFPattern() override;
    void doPostProcessing(ParamPostProcessing* params) override;
    void setProperty(VFProperty* property) override;
    VFProperty* getProperty() override;

  private:
    VFPatternProperty* mProperty;
};

}  // namespace VFontEffect
