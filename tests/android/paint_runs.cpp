#include <algorithm>
#include <cstddef>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <string>
#include <vector>

#include "voreleffect/VFEffect.h"

// Paints the runs of VorelEffectTest.java through the C++ interface and writes what each gave, one file
// a run: the four margins and the length of the key as 32-bit little-endian numbers, the key, the
// pixels.

using namespace VFontEffect;

namespace {

constexpr int kWidth = 67;
constexpr int kHeight = 49;
constexpr unsigned int kTextColour = 0x3366CC;

VFGradient stops[] = {{0xFF0000, 1.0F, 0.0F}, {0x00FF80, 0.75F, 0.4F}, {0x0000FF, 0.5F, 1.0F}};

void addPattern(VFEffect& look) {
    VFBitmap pattern(3, 2, 4);
    const unsigned int words[] = {0xFFFF0000, 0x8000FF00, 0x400000FF,
                                  0x12345678, 0xFFFFFFFF, 0xC0804020};
    for (unsigned int i = 0; i < 6; ++i) {
        for (unsigned int channel = 0; channel < 4; ++channel)
            pattern.mData[i * 4 + channel] = static_cast<unsigned char>(words[i] >> (24 - 8 * channel));
    }
    look.addPatternText(&pattern, 1.5F, 0.9F);
}

struct Look {
    const char* name;
    void (*describe)(VFEffect& look);
};

const Look kLooks[] = {
    {"plain", [](VFEffect&) {}},
    {"outer_shadow", [](VFEffect& look) { look.addOuterShadowText(120.5F, 5, 4, 0x102030, 0.7F); }},
    {"inner_shadow", [](VFEffect& look) { look.addInnerShadowText(-30.7F, 3, 2, 0xFFEEDD, 0.6F); }},
    {"outer_glow", [](VFEffect& look) { look.addOuterGlowText(6, 0xFFD700, 0.8F, 0, nullptr); }},
    {"outer_glow_stops", [](VFEffect& look) { look.addOuterGlowText(7, 0x123456, 0.9F, 3, stops); }},
    {"inner_glow", [](VFEffect& look) { look.addInnerGlowText(4, 0x00FFFF, 0.5F, 0, nullptr); }},
    {"inner_glow_stops", [](VFEffect& look) { look.addInnerGlowText(5, 0x654321, 1, 3, stops); }},
    {"linear", [](VFEffect& look) { look.addLinearGradientText(60, 0.8F, 0.9F, 3, stops); }},
    {"radial", [](VFEffect& look) { look.addRadialGradientText(1.2F, 0.8F, 2, stops); }},
    {"stroke_centre", [](VFEffect& look) { look.addStrokeText(3, 0xFFFFFF, 1, 7, 0); }},
    {"stroke_outside", [](VFEffect& look) { look.addStrokeText(4, 0x00AA00, 0.9F, 0, 1); }},
    {"stroke_inside", [](VFEffect& look) { look.addStrokeText(2, 0xAA0000, 0.4F, 0, 2); }},
    {"pattern", addPattern},
    {"translucent",
     [](VFEffect& look) {
         look.setTextOpacity(0.4F);
         look.addOuterShadowText(315, 6, 3, 0x000000, 0.8F);
         look.addStrokeText(2, 0xFF8800, 1, 0, 1);
     }},
    {"everything",
     [](VFEffect& look) {
         look.addOuterShadowText(45, 4, 6, 0x202020, 0.5F);
         look.addOuterGlowText(5, 0xFFFF00, 0.5F, 0, nullptr);
         look.addStrokeText(2, 0x000080, 1, 0, 1);
         look.addLinearGradientText(90, 1, 1, 3, stops);
         look.addInnerGlowText(3, 0xFFFFFF, 0.7F, 0, nullptr);
         look.addInnerShadowText(270, 2, 2, 0x400040, 0.9F);
     }},
};

/// A ring with soft edges.
std::vector<unsigned char> ring(int width, int height) {
    std::vector<unsigned char> coverage;
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            const int fromCentre = (x - 15) * (x - 15) + (y - 14) * (y - 14);
            coverage.push_back(
                static_cast<unsigned char>(std::max(255 - std::abs(fromCentre - 120) * 3, 0)));
        }
    }
    return coverage;
}

/// An upright bar, its first and last column half covered.
std::vector<unsigned char> bar(int width, int height) {
    std::vector<unsigned char> coverage;
    for (int i = 0; i < width * height; ++i)
        coverage.push_back(i % width == 0 || i % width == width - 1 ? 128 : 255);
    return coverage;
}

void paintRun(VFEffect& look, VFBitmap& picture) {
    auto ringBytes = ring(31, 29);
    auto barBytes = bar(11, 25);
    VFGlyph ringGlyph = {ringBytes.data(), 31, 29};
    VFGlyph barGlyph = {barBytes.data(), 11, 25};
    look.initEffect(kWidth, kHeight);
    look.setDstBitmap(&picture);
    look.renderEffectLayer(8, 9, &ringGlyph);
    look.renderEffectLayer(33, 11, &barGlyph);
    look.renderEffectLayer(60, -3, &barGlyph);
    look.doEffectPostProcessing();
    look.compositeLayers(&picture);
}

void writeNumber(std::string& to, size_t number) {
    for (int shift = 0; shift < 32; shift += 8)
        to.push_back(static_cast<char>(number >> shift));
}

/// Margins, key and the pixels of one run, then those of a second run over the first.
std::string paint(const Look& described) {
    VFEffect look;
    described.describe(look);
    const std::unique_ptr<char[]> keyBytes(look.getMapKey(kTextColour));
    const std::string key = keyBytes.get();
    std::string said;
    for (const int margin :
         {look.getLeftOffset(), look.getTopOffset(), look.getRightOffset(), look.getBottomOffset()})
        writeNumber(said, static_cast<size_t>(margin));
    writeNumber(said, key.size());
    said += key;
    VFBitmap picture(kWidth, kHeight, 4);
    for (int run = 0; run < 2; ++run) {
        paintRun(look, picture);
        said.append(reinterpret_cast<const char*>(picture.mData), size_t{kWidth} * kHeight * 4);
    }
    return said;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc != 2) {
        std::fprintf(stderr, "usage: paint_runs DIRECTORY\n");
        return 2;
    }
    for (const Look& look : kLooks) {
        const std::string path = std::string(argv[1]) + "/" + look.name;
        const std::string said = paint(look);
        std::FILE* const file = std::fopen(path.c_str(), "wb");
        const bool written =
            file != nullptr && std::fwrite(said.data(), 1, said.size(), file) == said.size();
        if (file == nullptr || std::fclose(file) != 0 || !written) {
            std::fprintf(stderr, "cannot write %s\n", path.c_str());
            return 1;
        }
    }
    return 0;
}
