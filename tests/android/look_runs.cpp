#include <algorithm>
#include <cstddef>
#include <cstdio>
#include <cstdlib>
#include <initializer_list>
#include <optional>
#include <string>
#include <vector>

#include "voreleffect/look.h"

// Paints the looks of LookTest.java through look.h and writes what each gave, one file a stack: the key
// of the last look with its length, the margins, a picture with its place, and two pages that were
// painted on, of R, G, B, A and of B, G, R, A. Numbers are 32-bit and little-endian.

using namespace VFontEffect;

namespace {

constexpr int kWidth = 67;
constexpr int kHeight = 49;
constexpr int kStride = 4 * kWidth + 12;

const std::vector<Stop> kStops = {
    {rgb(0xFF0000), 1.0F, 0.0F}, {rgb(0x00FF80), 0.75F, 0.4F}, {rgb(0x0000FF), 0.5F, 1.0F}};

Pattern pattern() {
    const unsigned char rgba[] = {0xFF, 0,    0,    0xFF, 0,    0xFF, 0,    0x80,
                                  0,    0,    0xFF, 0x40, 0x34, 0x56, 0x78, 0x12,
                                  0xFF, 0xFF, 0xFF, 0xFF, 0x80, 0x40, 0x20, 0xC0};
    return Pattern({rgba, 3, 2});
}

struct Stack {
    const char* name;
    std::vector<Look> looks;
};

std::vector<Stack> stacks() {
    const Look blue = Look().fill(rgb(0x3366CC));
    return {
        {"plain", {Look()}},
        {"outer_shadow",
         {Look(blue).add(OuterShadow(rgb(0x102030)).angle(120.5F).distance(5).opacity(0.7F))}},
        {"inner_shadow",
         {Look(blue).add(InnerShadow(rgb(0xFFEEDD)).angle(-30.7F).distance(3).size(2).opacity(0.6F))}},
        {"outer_glow", {Look(blue).add(OuterGlow(6, rgb(0xFFD700)).opacity(0.8F))}},
        {"outer_glow_stops", {Look(blue).add(OuterGlow(7, rgb(0)).opacity(0.9F).stops(kStops))}},
        {"inner_glow", {Look(blue).add(InnerGlow(4, rgb(0x00FFFF)).opacity(0.5F))}},
        {"inner_glow_stops", {Look(blue).add(InnerGlow(5, rgb(0)).stops(kStops))}},
        {"linear", {Look(blue).add(LinearGradient(kStops).angle(60).scale(0.8F).opacity(0.9F))}},
        {"radial", {Look(blue).add(RadialGradient(kStops).scale(1.2F).opacity(0.8F))}},
        {"stroke_centre", {Look(blue).add(Stroke(3, rgb(0xFFFFFF)).position(Position::centre))}},
        {"stroke_outside", {Look(blue).add(Stroke(4, rgb(0x00AA00)))}},
        {"stroke_inside",
         {Look(blue).add(Stroke(2, rgb(0xAA0000)).opacity(0.4F).position(Position::inside))}},
        {"pattern", {Look(blue).add(pattern().scale(1.5F).opacity(0.9F))}},
        {"translucent_fill", {Look().fill(rgb(0x3366CC), 0.5F).add(OuterShadow(rgb(0x800000)))}},
        {"translucent_text",
         {Look(blue).textOpacity(0.4F).add(OuterShadow(rgb(0x800000))).add(Stroke(2, rgb(0xFF8800)))}},
        {"no_fill", {Look(blue).noFill().add(OuterGlow(4, rgb(0x35C4FF)))}},
        {"order",
         {Look(blue).add(Stroke(3, rgb(1))).add(OuterShadow(rgb(2))).add(Stroke(5, rgb(0xFFFF00)))}},
        {"stack",
         {Look().fill(rgb(0x1D2A44)).add(Stroke(7, rgb(0x1D2A44)).opacity(0.7F)),
          Look().fill(rgb(0xFFE27A), 0.6F).add(Stroke(3, rgb(0xFFFFFF)))}},
        {"nothing", {}},
    };
}

std::vector<unsigned char> ring() {
    std::vector<unsigned char> coverage;
    for (int y = 0; y < 29; ++y)
        for (int x = 0; x < 31; ++x)
            coverage.push_back(static_cast<unsigned char>(
                std::max(255 - std::abs((x - 15) * (x - 15) + (y - 14) * (y - 14) - 120) * 3, 0)));
    return coverage;
}

/// Rows of 11 pixels that lie 13 bytes apart.
std::vector<unsigned char> bar() {
    std::vector<unsigned char> coverage;
    for (int i = 0; i < 13 * 25; ++i)
        coverage.push_back(i % 13 == 0 || i % 13 == 10 ? 128 : 255);
    return coverage;
}

void writeNumber(std::string& to, int number) {
    for (int shift = 0; shift < 32; shift += 8)
        to.push_back(static_cast<char>(static_cast<unsigned int>(number) >> shift));
}

void writeNumbers(std::string& to, std::initializer_list<int> numbers) {
    for (const int number : numbers)
        writeNumber(to, number);
}

void writePicture(std::string& to, const std::optional<Picture>& picture) {
    if (!picture) std::abort();
    writeNumbers(to, {picture->width(), picture->height(), picture->left(), picture->top()});
    if (!picture->isEmpty())
        to.append(
            reinterpret_cast<const char*>(picture->data()),
            static_cast<std::size_t>(picture->stride()) * static_cast<std::size_t>(picture->height()));
}

void writePage(std::string& to, Painter& painter, Glyphs glyphs, PixelOrder order) {
    std::vector<unsigned char> page;
    for (int i = 0; i < kStride * kHeight; ++i)
        page.push_back(static_cast<unsigned char>(i % 4 == 3 ? 255 : i * 7));
    const std::optional<Box> box =
        painter.paint(glyphs, {page.data(), kWidth, kHeight, kStride, order}, 5, -3);
    if (!box) std::abort();
    writeNumbers(to, {box->left, box->top, box->right, box->bottom});
    to.append(page.begin(), page.end());
}

std::string paint(const std::vector<Look>& looks) {
    const std::vector<unsigned char> ringBytes = ring();
    const std::vector<unsigned char> barBytes = bar();
    const std::vector<Glyph> glyphs = {{8, 9, ringBytes.data(), 31, 29},
                                       {33, 11, barBytes.data(), 11, 25, 13},
                                       {60, -3, barBytes.data(), 11, 25, 13}};
    std::string said;
    const std::string key = looks.empty() ? "" : looks.back().key();
    writeNumber(said, static_cast<int>(key.size()));
    said += key;
    Painter painter(looks);
    const Margins margins = painter.margins();
    writeNumbers(said, {margins.left, margins.top, margins.right, margins.bottom});
    writePicture(said, painter.paint(glyphs));
    writePage(said, painter, glyphs, PixelOrder::rgba);
    writePage(said, painter, glyphs, PixelOrder::bgra);
    return said;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc != 2) return 2;
    for (const Stack& stack : stacks()) {
        const std::string said = paint(stack.looks);
        std::FILE* const file = std::fopen((std::string(argv[1]) + "/" + stack.name).c_str(), "wb");
        if (file == nullptr) return 1;
        const bool isWritten = std::fwrite(said.data(), 1, said.size(), file) == said.size();
        if (std::fclose(file) != 0 || !isWritten) return 1;
    }
    return 0;
}
