// Lists of glyphs that are handed to a call, and, where VOREL_KEEP says so, one that is kept while what
// it points to is gone: clang warns of that.
#include <voreleffect/look.h>

#include <vector>

using namespace VFontEffect;

void handed(Painter& painter, const Glyph& a, const Glyph& b);
void handed(Painter& painter, const Glyph& a, const Glyph& b) {
    painter.paint({a, b});
    painter.paint(a);
    painter.paint(std::vector<Glyph>{a, b});
    const std::vector<Glyph> list{a, b};
    const Glyphs ofAList = list;
    painter.paint(ofAList);
#ifdef VOREL_KEEP
    const Glyphs kept = VOREL_KEEP;
    painter.paint(kept);
#endif
}
