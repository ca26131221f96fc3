// A gradient that turns: each frame's look has a key, and the picture of a key is painted once.
#include <map>
#include <optional>
#include <string>

#include "../shared/shaped_text.h"
#include "recipe.h"

using namespace VFontEffect;

namespace {

constexpr int kFrames = 48;  // of one turn: 7.5 degrees each

Look lookOf(int frame) {
    const float degrees = 360.0F * static_cast<float>(frame % kFrames) / kFrames;
    const std::vector<Stop> sky = {
        {rgb(0xFFF3B0), 1, 0}, {rgb(0xFF6B8B), 1, 0.5F}, {rgb(0x5B3FD9), 1, 1}};
    Look look;
    look.add(LinearGradient(sky).angle(degrees))
        .add(OuterShadow(rgb(0)).angle(degrees).distance(6).size(6))  // the light turns along
        .add(Stroke(3, rgb(0x1D1440)));
    return look;
}

/// Pictures by the keys of their looks and what the looks do not know. A program that runs for days
/// bounds it: a picture takes 4 bytes a pixel.
class Pictures {
  public:
    /// Null where there is no memory for one. It stays where it is.
    const Picture* of(const Look& look, const Line& line, const std::string& text) {
        const std::string key = look.key() + '/' + text;
        const auto known = mPictures.find(key);
        if (known != mPictures.end()) return &known->second;
        std::optional<Picture> picture = paint(look, line.glyphs);
        if (!picture) return nullptr;
        ++mPainted;
        return &mPictures.emplace(key, std::move(*picture)).first->second;
    }
    int painted() const { return mPainted; }

  private:
    std::map<std::string, Picture> mPictures;
    int mPainted = 0;
};

Page frameOf(int frame, const Line& line, Pictures& pictures) {
    Page page(200, 100, 0xFBEFD5);
    const Picture* picture = pictures.of(lookOf(frame), line, "Spin/DejaVu Sans Bold/64");
    check(picture != nullptr, "a picture");
    picture->layOver(page.view(), 20, 70);
    return page;
}

/// Angles are whole degrees: of two steps of half a degree each the second paints nothing.
void checkSteps(const Line& line) {
    Pictures pictures;
    for (int step = 0; step < 720; ++step) {
        const float degrees = static_cast<float>(step) / 2;
        pictures.of(Look().add(OuterShadow(rgb(0)).angle(degrees)), line, "Spin/DejaVu Sans Bold/8");
    }
    check(pictures.painted() == 360, "a picture for each whole degree");
}

}  // namespace

int main() {
    const Line line = Font(kFont, 64).line("Spin");
    Pictures pictures;
    std::vector<Page> first;
    for (int frame = 0; frame < kFrames; ++frame)
        first.push_back(frameOf(frame, line, pictures));
    check(pictures.painted() == kFrames, "a picture for each angle");

    // The second turn paints nothing, and looks as the first.
    for (std::size_t frame = 0; frame < kFrames; ++frame) {
        const Page again = frameOf(kFrames + static_cast<int>(frame), line, pictures);
        check(again == first[frame], "the same frames again");
    }
    check(pictures.painted() == kFrames, "nothing painted anew");
    checkSteps(Font(kFont, 8).line("Spin"));

    Page strip(800, 100, 0xFBEFD5);
    for (int column = 0; column < 4; ++column)
        pictures.of(lookOf(column * kFrames / 4), line, "Spin/DejaVu Sans Bold/64")
            ->layOver(strip.view(), column * 200 + 20, 70);
    check(strip.writePng("animation.png"), "a PNG");
    return 0;
}
