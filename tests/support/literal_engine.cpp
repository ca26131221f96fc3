#include "literal_engine.h"

#include <algorithm>
#include <cstddef>

#include "literal_blend.h"
#include "literal_cores.h"

namespace vorel_test::literal {

namespace {

constexpr unsigned kNoCore = 0xFFFFFFFFU;

// --- Numbers ------------------------------------------------------------------------------------

/// From 0 to `high`; a NaN becomes 0.
float clamped(float value, float high) {
    if (!(value > 0.0F)) return 0.0F;
    if (value > high) return high;
    return value;
}

uint32_t alphaByte(float opacity) {
    const float a = opacity * 255.0F + 0.5F;
    if (a > 255.0F) return 255;
    if (!(a >= 0.0F)) return 0;
    return static_cast<uint32_t>(truncated(a));
}

uint32_t premultiplied(uint32_t color, float opacity) {
    const uint32_t a = alphaByte(opacity);
    const uint32_t r = std::min(255U, (a * (((color >> 16) & 0xFF) + 1)) >> 8);
    const uint32_t g = std::min(255U, (a * (((color >> 8) & 0xFF) + 1)) >> 8);
    const uint32_t b = std::min(255U, (a * ((color & 0xFF) + 1)) >> 8);
    return a << 24 | r << 16 | g << 8 | b;
}

uint32_t straight(uint32_t color, float opacity) {
    return (color & 0x00FFFFFFU) | alphaByte(opacity) << 24;
}

float wholeDegrees(float angle) {
    int d = truncated(angle) % 360;
    if (d < 0) d += 360;
    return static_cast<float>(d);
}

float wholePixels(float value) {
    const int pixels = truncated(value);
    return static_cast<float>(std::min(std::max(pixels, 0), 100));
}

std::vector<Stop> copiedStops(int count, const Stop* stops, float opacity) {
    const int n = std::min(std::max(count, 0), 256);
    std::vector<Stop> copies;
    for (int i = 0; i < n; ++i) {
        const Stop& source = stops[i];
        Stop copy;
        copy.color = straight(source.color, clamped(opacity * source.opacity, 1.0F));
        copy.opacity = clamped(source.opacity, 1.0F);
        const int hundredths = truncated(source.location * 100.0F);
        copy.location = clamped(static_cast<float>(hundredths) / 100.0F, 1.0F);
        copies.push_back(copy);
    }
    return copies;
}

// --- Offsets ------------------------------------------------------------------------------------

Margins evenMargins(int offset) {
    return Margins{offset, offset, offset, offset};
}

Margins marginsOf(const Effect& e) {
    if (e.kind == kOuterShadow) return outerShadowMargins(e.angle, e.distance, e.size);
    if (e.kind == kOuterGlow || e.kind == kInnerGlow) return evenMargins(glowOffset(e.size));
    if (e.kind == kStroke) return evenMargins(strokeOffset(e.size, e.position));
    return Margins{};
}

// --- Key ----------------------------------------------------------------------------------------

void putByte(std::string& key, uint32_t low) {
    key.push_back(static_cast<char>(0x80U | low));
}

void putSmall(std::string& key, int value) {
    putByte(key, static_cast<uint32_t>(value) & 0x7FU);
}

void putWord(std::string& key, uint32_t word) {
    for (int shift = 28; shift >= 0; shift -= 4)
        putByte(key, (word >> shift) & 0xFU);
}

void putAngle(std::string& key, float angle) {
    int d = truncated(angle) % 360;
    if (d < 0) d += 360;
    putByte(key, static_cast<uint32_t>(d >> 7) & 0x7FU);
    putByte(key, static_cast<uint32_t>(d) & 0x7FU);
}

void putBytePair(std::string& key, int value) {
    putByte(key, static_cast<uint32_t>(value >> 4) & 0xFU);
    putByte(key, static_cast<uint32_t>(value) & 0xFU);
}

void putStops(std::string& key, const std::vector<Stop>& stops) {
    for (const Stop& stop : stops) {
        putWord(key, stop.color);
        putSmall(key, truncated(stop.location * 100.0F));
    }
}

void putShadow(std::string& key, char letter, const Effect& e) {
    key.push_back(letter);
    putAngle(key, e.angle);
    putSmall(key, truncated(e.distance));
    putSmall(key, truncated(e.size));
    putWord(key, e.color);
}

void putGlow(std::string& key, char letter, const Effect& e) {
    key.push_back(letter);
    putSmall(key, truncated(e.size));
    putWord(key, e.color);
    putStops(key, e.stops);
}

void putGradient(std::string& key, char letter, const Effect& e) {
    key.push_back(letter);
    putAngle(key, e.angle);
    putBytePair(key, truncated(e.scale * 100.0F));
    putStops(key, e.stops);
}

void putFragment(std::string& key, const Effect& e) {
    switch (e.kind) {
        case kText:
            key.push_back('T');
            putWord(key, e.color);
            break;
        case kOuterShadow:
            putShadow(key, 'S', e);
            break;
        case kInnerShadow:
            putShadow(key, 'I', e);
            break;
        case kStroke:
            key.push_back('K');
            putSmall(key, truncated(e.size));
            putWord(key, e.color);
            putSmall(key, e.strokeStyle);
            putSmall(key, e.position);
            break;
        case kOuterGlow:
            putGlow(key, 'G', e);
            break;
        case kInnerGlow:
            putGlow(key, 'N', e);
            break;
        case kLinearGradient:
            putGradient(key, 'L', e);
            break;
        case kRadialGradient:
            putGradient(key, 'D', e);
            break;
        default:  // a pattern writes nothing
            break;
    }
}

}  // namespace

void paintText(Picture& dst, const Mask& mask, bool useOuterLayer, uint32_t color) {
    drawBitmapBlend8(0, 0, dst.bytes.data(), dst.width, dst.height, mask.bytes.data(), mask.width,
                     mask.height, mask.width, color, useOuterLayer ? 3 : 7);
}

// --- Add-calls ----------------------------------------------------------------------------------

namespace {

Effect shadow(int kind, float angle, float distance, float size, uint32_t color, float opacity) {
    Effect e;
    e.kind = kind;
    e.opacity = clamped(opacity, 1.0F);
    e.angle = wholeDegrees(angle);
    e.distance = wholePixels(distance);
    e.size = wholePixels(size);
    e.color = premultiplied(color, e.opacity);
    return e;
}

Effect glow(int kind, float size, uint32_t color, float opacity, int count, const Stop* stops) {
    Effect e;
    e.kind = kind;
    e.opacity = clamped(opacity, 1.0F);
    e.size = wholePixels(size);
    e.color = straight(color, e.opacity);
    e.stops = copiedStops(count, stops, e.opacity);
    return e;
}

}  // namespace

unsigned Engine::addOuterShadowText(float angle, float distance, float size, uint32_t color,
                                    float opacity) {
    return static_cast<unsigned>(
        addEffect(-1, shadow(kOuterShadow, angle, distance, size, color, opacity)));
}

unsigned Engine::addInnerShadowText(float angle, float distance, float size, uint32_t color,
                                    float opacity) {
    return static_cast<unsigned>(
        addEffect(-1, shadow(kInnerShadow, angle, distance, size, color, opacity)));
}

unsigned Engine::addOuterGlowText(float size, uint32_t color, float opacity, int count,
                                  const Stop* stops) {
    return static_cast<unsigned>(addEffect(-1, glow(kOuterGlow, size, color, opacity, count, stops)));
}

unsigned Engine::addInnerGlowText(float size, uint32_t color, float opacity, int count,
                                  const Stop* stops) {
    return static_cast<unsigned>(addEffect(-1, glow(kInnerGlow, size, color, opacity, count, stops)));
}

unsigned Engine::addLinearGradientText(float angle, float scale, float opacity, int count,
                                       const Stop* stops) {
    Effect e;
    e.kind = kLinearGradient;
    e.opacity = clamped(opacity, 1.0F);
    e.angle = wholeDegrees(angle);
    e.scale = clamped(scale, 2.0F);
    e.stops = copiedStops(count, stops, e.opacity);
    return static_cast<unsigned>(addEffect(-1, e));
}

unsigned Engine::addRadialGradientText(float scale, float opacity, int count, const Stop* stops) {
    Effect e;
    e.kind = kRadialGradient;
    e.opacity = clamped(opacity, 1.0F);
    e.scale = clamped(scale, 2.0F);
    e.stops = copiedStops(count, stops, e.opacity);
    return static_cast<unsigned>(addEffect(-1, e));
}

unsigned Engine::addStrokeText(float size, uint32_t color, float opacity, int strokeStyle,
                               int position) {
    Effect e;
    e.kind = kStroke;
    e.opacity = clamped(opacity, 1.0F);
    e.size = wholePixels(size);
    e.color = premultiplied(color, e.opacity);
    e.strokeStyle = strokeStyle;
    e.position = position;
    return static_cast<unsigned>(addEffect(-1, e));
}

unsigned Engine::addPatternText(const Tile* tile, float scale, float opacity) {
    Effect e;
    e.kind = kPattern;
    e.opacity = clamped(opacity, 1.0F);
    e.scale = clamped(scale, 10.0F);
    e.hasTile = tile != nullptr;
    if (e.hasTile) e.tile = *tile;
    return static_cast<unsigned>(addEffect(-1, e));
}

unsigned Engine::addText(uint32_t color, float opacity) {
    Effect e;
    e.kind = kText;
    e.opacity = clamped(opacity, 1.0F);
    e.color = premultiplied(color, e.opacity);
    return static_cast<unsigned>(addEffect(-1, e));
}

unsigned Engine::addKindWithoutCore() {
    mOrdered = false;
    return kNoCore;
}

// --- Registry -----------------------------------------------------------------------------------

Engine::Engine(const Engine& other)
    : mUseOuterLayer(other.mUseOuterLayer),
      mTextOpacity(other.mTextOpacity),
      mNextId(other.mNextId),
      mOrdered(other.mOrdered) {
    for (const Effect& effect : other.mEffects)
        addEffect(effect.id, effect);
}

int Engine::addEffect(int id, const Effect& effect) {
    mOrdered = false;
    for (Effect& present : mEffects) {
        if (present.kind != effect.kind) continue;
        const int kept = present.id;
        present = effect;
        present.id = kept;
        return kept;
    }
    Effect added = effect;
    if (id < 0) {
        added.id = mNextId;
        mNextId += 1;
    } else {
        added.id = id;
    }
    mEffects.push_back(added);
    return added.id;
}

const Effect* Engine::getEffect(int kind) const {
    for (const Effect& effect : mEffects) {
        if (effect.kind == kind) return &effect;
    }
    return nullptr;
}

bool Engine::removeEffect(int id) {
    for (size_t i = 0; i < mEffects.size(); ++i) {
        if (mEffects[i].id != id) continue;
        mEffects.erase(mEffects.begin() + static_cast<std::ptrdiff_t>(i));
        return true;
    }
    return false;
}

void Engine::releaseEffect() {
    mEffects.clear();
    mNextId = 0;
}

bool Engine::hasEffects() const {
    return !mEffects.empty() || mTextOpacity < 1.0F;
}

void Engine::setTextOpacity(float opacity) {
    if (opacity != mTextOpacity) mOrdered = false;
    mTextOpacity = clamped(opacity, 1.0F);
}

// --- Planning -----------------------------------------------------------------------------------

bool Engine::isUnderEffect(const Effect& effect) const {
    switch (effect.kind) {
        case kOuterShadow:
        case kOuterGlow:
            return true;
        case kStroke:
        case kReserved:
            if (effect.position == 1) return true;
            if (effect.position == 0) return !mUseOuterLayer;
            return false;
        default:
            return false;
    }
}

void Engine::reorder() {
    if (mUseOuterLayer) {
        std::vector<Effect> reversed;
        for (const Effect& effect : mEffects)
            reversed.insert(reversed.begin(), effect);
        for (size_t i = 0; i < reversed.size(); ++i) {
            if (reversed[i].kind != kText) continue;
            const Effect text = reversed[i];
            reversed.erase(reversed.begin() + static_cast<std::ptrdiff_t>(i));
            reversed.push_back(text);
            break;
        }
        mEffects = reversed;
        return;
    }
    std::vector<Effect> over, under;
    for (const Effect& effect : mEffects) {
        if (isUnderEffect(effect)) {
            under.insert(under.begin(), effect);
        } else if (effect.kind == kText) {
            over.push_back(effect);
        } else {
            over.insert(over.begin(), effect);
        }
    }
    mEffects = over;
    for (const Effect& effect : under)
        mEffects.push_back(effect);
}

void Engine::initEffect(int width, int height) {
    if (mTextOpacity < 1.0F) {
        mUseOuterLayer = true;
    } else {
        mUseOuterLayer = false;
        for (const Effect& effect : mEffects) {
            const bool stroke = effect.kind == kStroke || effect.kind == kReserved;
            if (stroke && effect.position == 0) mUseOuterLayer = true;
        }
    }
    const size_t pixels = static_cast<size_t>(width) * static_cast<size_t>(height);
    mMask = Mask{width, height, std::vector<uint8_t>(pixels, 0)};
    mHasMask = true;
    if (mUseOuterLayer) mOuterLayer = Picture{width, height, std::vector<uint8_t>(pixels * 4, 0)};
    if (!mOrdered) {
        reorder();
        mOrdered = true;
    }
    mDestination = nullptr;
}

Margins Engine::margins() const {
    Margins all;
    for (const Effect& effect : mEffects) {
        const Margins one = marginsOf(effect);
        all.left = std::max(all.left, one.left);
        all.right = std::max(all.right, one.right);
        all.top = std::max(all.top, one.top);
        all.bottom = std::max(all.bottom, one.bottom);
    }
    return all;
}

// --- One run ------------------------------------------------------------------------------------

void Engine::renderEffectLayer(int x, int y, const Mask* glyph) {
    if (glyph == nullptr || !mHasMask) return;
    const Box box{x, y, x + glyph->width, y + glyph->height};
    if (mResetTextRect) {
        mTextRect = box;
        mResetTextRect = false;
    } else {
        mTextRect.left = std::min(mTextRect.left, box.left);
        mTextRect.top = std::min(mTextRect.top, box.top);
        mTextRect.right = std::max(mTextRect.right, box.right);
        mTextRect.bottom = std::max(mTextRect.bottom, box.bottom);
    }
    drawBitmap8To8(x, y, mMask.bytes.data(), mMask.width, mMask.height, glyph->bytes.data(),
                   glyph->width, glyph->height);
}

void Engine::paint(const Effect& e, Picture* dst, Picture* sub) {
    if (dst == nullptr) return;
    switch (e.kind) {
        case kOuterShadow:
            paintOuterShadow(*dst, mMask, mTextRect, e.angle, e.distance, e.size, e.color);
            break;
        case kInnerShadow:
            paintInnerShadow(*dst, mMask, mTextRect, e.angle, e.distance, e.size, e.color);
            break;
        case kOuterGlow:
            paintOuterGlow(*dst, mMask, mTextRect, e.size, e.color, e.stops);
            break;
        case kInnerGlow:
            paintInnerGlow(*dst, mMask, mTextRect, e.size, e.color, e.stops);
            break;
        case kLinearGradient:
            paintLinearGradient(*dst, mMask, mTextRect, e.angle, e.scale, e.stops);
            break;
        case kRadialGradient:
            paintRadialGradient(*dst, mMask, mTextRect, e.scale, e.stops);
            break;
        case kStroke:
            paintStroke(*dst, sub, mMask, mTextRect, mUseOuterLayer, e.size, e.color, e.position);
            break;
        case kPattern:
            if (!e.hasTile) break;
            paintPattern(*dst, mMask, mTextRect, e.opacity, e.scale, e.tile.width, e.tile.height,
                         e.tile.bytes);
            break;
        case kText:
            paintText(*dst, mMask, mUseOuterLayer, e.color);
            break;
        default:
            break;
    }
}

void Engine::doEffectPostProcessing() {
    if (!mHasMask) {
        mResetTextRect = true;
        return;
    }
    mTextRect.left = std::min(std::max(mTextRect.left, 0), mMask.width);
    mTextRect.right = std::max(std::min(mTextRect.right, mMask.width), 0);
    mTextRect.top = std::min(std::max(mTextRect.top, 0), mMask.height);
    mTextRect.bottom = std::max(std::min(mTextRect.bottom, mMask.height), 0);

    if (mTextRect.right > mTextRect.left && mTextRect.bottom > mTextRect.top) {
        for (const Effect& effect : mEffects) {
            Picture* dst = mDestination;
            Picture* sub = nullptr;
            if (mUseOuterLayer) {
                switch (effect.kind) {
                    case kOuterShadow:
                    case kOuterGlow:
                        dst = &mOuterLayer;
                        break;
                    case kStroke:
                    case kReserved:
                        if (effect.position == 0) {
                            dst = &mOuterLayer;
                            sub = mDestination;
                        } else if (effect.position == 2) {
                            dst = mDestination;
                        } else {
                            dst = &mOuterLayer;
                        }
                        break;
                    default:
                        dst = mDestination;
                        break;
                }
            }
            paint(effect, dst, sub);
        }
    }
    mResetTextRect = true;
}

void Engine::compositeLayers(Picture& destination) {
    if (mUseOuterLayer) {
        composite(destination.bytes.data(), mOuterLayer.bytes.data(), mMask.bytes.data(),
                  destination.width * destination.height);
    }
    mMask = Mask{};
    mHasMask = false;
    mOuterLayer = Picture{};
    mDestination = nullptr;
    mUseOuterLayer = false;
}

// --- Cache key ----------------------------------------------------------------------------------

std::string Engine::getMapKey() const {
    std::string key;
    for (const Effect& effect : mEffects)
        putFragment(key, effect);
    return key;
}

std::string Engine::getMapKey(uint32_t color) {
    addText(color, mTextOpacity);
    return getMapKey();
}

}  // namespace vorel_test::literal
