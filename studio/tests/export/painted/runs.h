/* What the exported functions of C and C++ are run with. */
#pragma once

#include <voreleffect/voreleffect_c.h>

#ifdef __cplusplus
extern "C" {
#endif

/* The glyphs of a span: the same as the structure that exports for C declare. */
typedef struct c_run {
    const vorel_glyph* glyphs;
    size_t count;
} c_run;

typedef struct c_text {
    const vorel_glyph* glyphs;
    size_t count;
    const c_run* lines;
    size_t line_count;
    const c_run* words;
    size_t word_count;
    const c_run* letters;
    size_t letter_count;
    const vorel_pixels* patterns;
} c_text;

typedef vorel_status (*c_case)(const c_text* text, const vorel_view* page, int32_t x, int32_t y);

#ifdef __cplusplus
}

#include <voreleffect/look.h>

#include <vector>

/* A text in its spans. */
struct Text {
    std::vector<VFontEffect::Glyph> glyphs;
    std::vector<std::vector<VFontEffect::Glyph>> lines;
    std::vector<std::vector<VFontEffect::Glyph>> words;
    std::vector<std::vector<VFontEffect::Glyph>> letters;
    std::vector<VFontEffect::PixelView> patterns;
};

using LookCase = bool (*)(const Text& text, const VFontEffect::PictureView& page, int x, int y);

/* A look by the classes and its place. */
struct ClassLook {
    void (*add)(VFontEffect::VFEffect& look);
    int offsetX;
    int offsetY;
    const char* span;
};

using ClassCase = std::vector<ClassLook> (*)();

/* What an export is, by its number; defined by what is generated. */
struct Case {
    const char* name;
    LookCase look;
    ClassCase classes;
    c_case c;
};
extern const Case kCases[];
extern const int kCaseCount;
#endif
