#pragma once

#include <voreleffect/look.h>
#include <voreleffect/voreleffect.h>

#include <cstdio>
#include <optional>
#include <string>
#include <thread>
#include <vector>

/// Names that a fragment of code in the documents may use without declaring them.
using namespace VFontEffect;

struct PlacedGlyph {
    int x;
    int y;
    VFGlyph glyph;
};

extern VFEffect look;
extern std::vector<PlacedGlyph> glyphs;
extern int textWidth;
extern int textHeight;

void paintLines(VFEffect& look, int first, int end);
