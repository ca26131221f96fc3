// Paints every case by its exports for look.h, for the classes and for C: run_exports FOLDER
//
// FOLDER has the pages (pages.txt: NAME WIDTH HEIGHT X Y in each line), NAME.masks and NAME.patterns,
// and gets NAME.cpp-look.rgba, NAME.cpp-classes.rgba and NAME.c.rgba, premultiplied.
#include <cstdint>
#include <cstring>
#include <fstream>
#include <iostream>
#include <iterator>
#include <map>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "runs.h"

namespace {

using namespace VFontEffect;

using Bytes = std::vector<unsigned char>;

/// Numbers of 4 bytes, and bytes, one behind the other.
class Reader {
  public:
    explicit Reader(const std::string& file) {
        std::ifstream in(file, std::ios::binary);
        mBytes.assign(std::istreambuf_iterator<char>(in), {});
    }
    int number() {
        uint32_t value = 0;
        for (int i = 0; i < 4; ++i)
            value = value << 8 | mBytes.at(mAt++);
        return static_cast<int>(value);
    }
    const unsigned char* bytes(int count) {
        const unsigned char* start = mBytes.data() + mAt;
        mAt += static_cast<size_t>(count);
        return start;
    }

  private:
    Bytes mBytes;
    size_t mAt = 0;
};

struct Page {
    int width = 0;
    int height = 0;
    int x = 0;
    int y = 0;
};

std::vector<std::vector<Glyph>> spans(const std::map<std::pair<int, int>, std::vector<Glyph>>& parts) {
    std::vector<std::vector<Glyph>> lists;
    for (const auto& part : parts)
        lists.push_back(part.second);
    return lists;
}

Text readText(Reader& masks, Reader& patterns) {
    Text text;
    std::map<std::pair<int, int>, std::vector<Glyph>> lines;
    std::map<std::pair<int, int>, std::vector<Glyph>> words;
    std::map<std::pair<int, int>, std::vector<Glyph>> letters;
    for (int count = masks.number(); count > 0; --count) {
        Glyph glyph;
        for (int* number : {&glyph.x, &glyph.y, &glyph.width, &glyph.height})
            *number = masks.number();
        const int line = masks.number();
        const int word = masks.number();
        const int cluster = masks.number();
        glyph.coverage = masks.bytes(glyph.width * glyph.height);
        text.glyphs.push_back(glyph);
        lines[{line, 0}].push_back(glyph);
        words[{line, word}].push_back(glyph);
        letters[{line, cluster}].push_back(glyph);
    }
    text.lines = spans(lines);
    text.words = spans(words);
    text.letters = spans(letters);
    for (int count = patterns.number(); count > 0; --count) {
        const int width = patterns.number();
        const int height = patterns.number();
        text.patterns.push_back({patterns.bytes(4 * width * height), width, height});
    }
    return text;
}

Bytes clear(const Page& page) {
    return Bytes(static_cast<size_t>(page.width) * static_cast<size_t>(page.height) * 4);
}

/// One run by the classes, laid over the page as the comment of the exported table tells.
void paintRun(VFEffect& effects, const ClassLook& look, const std::vector<Glyph>& glyphs,
              const Page& page, Bytes& pixels) {
    VFBitmap picture(static_cast<unsigned>(page.width), static_cast<unsigned>(page.height), 4);
    effects.initEffect(page.width, page.height);
    effects.setDstBitmap(&picture);
    for (const Glyph& glyph : glyphs) {
        VFGlyph mask = {const_cast<unsigned char*>(glyph.coverage),
                        static_cast<unsigned short>(glyph.width),
                        static_cast<unsigned short>(glyph.height)};
        effects.renderEffectLayer(page.x + look.offsetX + glyph.x, page.y + look.offsetY + glyph.y,
                                  &mask);
    }
    effects.doEffectPostProcessing();
    effects.compositeLayers(&picture);
    for (size_t i = 0; i < pixels.size(); ++i) {
        const int rest = 255 - picture.mData[i / 4 * 4 + 3];
        pixels[i] = static_cast<unsigned char>(picture.mData[i] + (pixels[i] * rest + 127) / 255);
    }
}

void paintClasses(const std::vector<ClassLook>& looks, const Text& text, const Page& page,
                  Bytes& pixels) {
    for (const ClassLook& look : looks) {
        VFEffect effects;
        look.add(effects);
        const std::map<std::string, std::vector<std::vector<Glyph>>> parts = {{"block", {text.glyphs}},
                                                                              {"line", text.lines},
                                                                              {"word", text.words},
                                                                              {"glyph", text.letters}};
        for (const std::vector<Glyph>& run : parts.at(look.span))
            paintRun(effects, look, run, page, pixels);
    }
}

/// The text as C takes it; the structures have the same fields.
class CText {
  public:
    explicit CText(const Text& text) {
        mGlyphs = converted(text.glyphs);
        convert(text.lines, mLines);
        convert(text.words, mWords);
        convert(text.letters, mLetters);
        for (const PixelView& pixels : text.patterns)
            mPatterns.push_back({pixels.data, pixels.width, pixels.height, pixels.stride});
    }
    c_text get() const {
        return {mGlyphs.data(), mGlyphs.size(),  mLines.data(),   mLines.size(),   mWords.data(),
                mWords.size(),  mLetters.data(), mLetters.size(), mPatterns.data()};
    }

  private:
    static std::vector<vorel_glyph> converted(const std::vector<Glyph>& glyphs) {
        std::vector<vorel_glyph> list;
        for (const Glyph& glyph : glyphs)
            list.push_back({glyph.x, glyph.y, glyph.coverage, glyph.width, glyph.height, glyph.stride});
        return list;
    }
    void convert(const std::vector<std::vector<Glyph>>& spans, std::vector<c_run>& runs) {
        for (const std::vector<Glyph>& span : spans) {
            mKept.push_back(std::make_unique<std::vector<vorel_glyph>>(converted(span)));
            runs.push_back({mKept.back()->data(), mKept.back()->size()});
        }
    }

    std::vector<vorel_glyph> mGlyphs;
    std::vector<std::unique_ptr<std::vector<vorel_glyph>>> mKept;
    std::vector<c_run> mLines;
    std::vector<c_run> mWords;
    std::vector<c_run> mLetters;
    std::vector<vorel_pixels> mPatterns;
};

void write(const std::string& file, const Bytes& bytes) {
    std::ofstream out(file, std::ios::binary);
    out.write(reinterpret_cast<const char*>(bytes.data()), static_cast<std::streamsize>(bytes.size()));
}

bool paintCase(const Case& each, const std::string& stem, const Page& page) {
    Reader masks(stem + ".masks");
    Reader patterns(stem + ".patterns");
    const Text text = readText(masks, patterns);

    Bytes byLook = clear(page);
    const bool isPainted = each.look(text, {byLook.data(), page.width, page.height}, page.x, page.y);
    write(stem + ".cpp-look.rgba", byLook);

    Bytes byClasses = clear(page);
    paintClasses(each.classes(), text, page, byClasses);
    write(stem + ".cpp-classes.rgba", byClasses);

    Bytes byC = clear(page);
    const CText inC(text);
    const c_text handed = inC.get();
    const vorel_view view = {byC.data(), page.width, page.height, 0, VOREL_RGBA};
    const vorel_status status = each.c(&handed, &view, page.x, page.y);
    write(stem + ".c.rgba", byC);
    return isPainted && status == VOREL_OK;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc != 2) return 2;
    const std::string folder = std::string(argv[1]) + "/";
    std::map<std::string, Page> pages;
    std::ifstream list(folder + "pages.txt");
    std::string name;
    for (Page page; list >> name >> page.width >> page.height >> page.x >> page.y;)
        pages[name] = page;
    for (int i = 0; i < kCaseCount; ++i) {
        const Case& each = kCases[i];
        if (paintCase(each, folder + each.name, pages.at(each.name))) continue;
        std::cerr << each.name << ": not painted\n";
        return 1;
    }
    return 0;
}
