// What PNG files of the tool's pictures take, as a table: bytes, and processor time of encoding in
// memory, beside libpng's default (its simplified interface, which the tool used before).

#include <png.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <ctime>
#include <functional>
#include <random>
#include <string>
#include <utility>
#include <vector>

#include "compose/background.h"
#include "painting.h"
#include "png_writer.h"
#include "style_file.h"

namespace {

using vorelpaint::Options;
using vorelpaint::PngEffort;
using voreltext::Image;

struct Group {
    std::string name;
    std::vector<Image> pictures;
};

// --- pictures -----------------------------------------------------------------------------------------

Image painted(const Options& options) {
    Image picture = vorelpaint::composed(options).paint();
    layOn(picture, options.background);
    return picture;
}

Options textOptions(const std::string& text, int size) {
    Options options;
    options.fonts = {"DejaVu Sans:bold"};
    options.text = text;
    options.size = size;
    return options;
}

Group gallery(const std::string& name, const std::string& background) {
    Group group{name, {}};
    for (const std::string& preset : vorelpaint::presetNames()) {
        Options options = textOptions("Typefaces", 96);
        options.preset = preset;
        options.background = vorelpaint::parseBackground(background).value();
        group.pictures.push_back(painted(options));
    }
    return group;
}

Group styled(const std::string& name, const std::string& style, int size) {
    Group group{name, {}};
    for (const char* text : {"Harbour lights over quiet water", "When evening falls on the bay",
                             "And distant bells begin to ring"}) {
        Options options = textOptions(text, size);
        options.inlineStyle = vorelstyle::parseStyle(style, name);
        group.pictures.push_back(painted(options));
    }
    return group;
}

/// A picture whose channels are functions of the place, from 0 to 1.
Image drawn(int width, int height, const std::function<double(int, double, double)>& channel) {
    Image image{width, height, {}};
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            for (int c = 0; c < 4; ++c) {
                const double value = channel(c, 1.0 * x / (width - 1), 1.0 * y / (height - 1));
                image.pixels.push_back(static_cast<uint8_t>(std::lround(255 * value)));
            }
        }
    }
    return image;
}

Group gradients() {
    const auto slope = [](int c, double x, double y) {
        return c == 3 ? 1.0 : std::abs((c + 1) * (x + 0.5 * y) / 4.5);
    };
    const auto disc = [](int c, double x, double y) {
        const double far = std::min(1.0, 2 * std::hypot(x - 0.5, y - 0.5));
        return c == 3 ? 1 - far : (c + 1) * (1 - far) / 3;
    };
    return {"gradients, 800 x 600", {drawn(800, 600, slope), drawn(800, 600, disc)}};
}

Image photograph(int width, int height) {
    std::mt19937 random(7);
    std::uniform_real_distribution<double> noise(-0.02, 0.02);
    const auto channel = [&](int c, double x, double y) {
        const double waves = std::sin(7 * x + c) * std::cos(5 * y - 2 * x) + std::sin(23 * x * y + c);
        return c == 3 ? 1.0 : 0.5 + 0.22 * waves + noise(random);
    };
    return drawn(width, height, channel);
}

/// Letters through which a photograph shows.
Group photographInLetters() {
    Group group{"a photograph in letters", {}};
    for (const char* text : {"Harbour", "Evening", "Distant"}) {
        Image letters = painted(textOptions(text, 160));
        const Image within = photograph(letters.width, letters.height);
        for (size_t i = 0; i < letters.pixels.size(); ++i) {
            if (i % 4 != 3 && letters.pixels[i / 4 * 4 + 3] != 0) letters.pixels[i] = within.pixels[i];
        }
        group.pictures.push_back(std::move(letters));
    }
    return group;
}

Group largeAndFlat() {
    Options options = textOptions("Typefaces", 96);
    options.preset = "subtitle";
    options.canvas.width = 4000;
    options.canvas.height = 3000;
    Group group{"large and flat, 4000 x 3000", {painted(options)}};
    options.background = vorelpaint::parseBackground("#23272E").value();
    group.pictures.push_back(painted(options));
    return group;
}

// --- figures ------------------------------------------------------------------------------------------

size_t encodedByLibpng(const Image& image) {
    png_image record{};
    record.version = PNG_IMAGE_VERSION;
    record.width = static_cast<png_uint_32>(image.width);
    record.height = static_cast<png_uint_32>(image.height);
    record.format = PNG_FORMAT_RGBA;
    png_alloc_size_t size = PNG_IMAGE_PNG_SIZE_MAX(record);
    std::vector<uint8_t> file(size);
    png_image_write_to_memory(&record, file.data(), &size, 0, image.pixels.data(), 0, nullptr);
    return size;
}

struct Maker {
    const char* name;
    std::function<size_t(const Image&)> size;  ///< of the file that it makes
};

const std::vector<Maker>& makers() {
    const auto by = [](PngEffort effort) {
        return [effort](const Image& image) { return vorelpaint::encodedPng(image, effort).size(); };
    };
    static const std::vector<Maker> all{{"libpng", encodedByLibpng},
                                        {"fast", by(PngEffort::fast)},
                                        {"normal", by(PngEffort::normal)},
                                        {"small", by(PngEffort::small)}};
    return all;
}

struct Figure {
    size_t bytes = 0;
    std::vector<double> milliseconds;

    double median() {
        std::sort(milliseconds.begin(), milliseconds.end());
        return milliseconds[milliseconds.size() / 2];
    }
};

double processorTime() {
    timespec now{};
    ::clock_gettime(CLOCK_THREAD_CPUTIME_ID, &now);
    return 1e3 * static_cast<double>(now.tv_sec) + 1e-6 * static_cast<double>(now.tv_nsec);
}

/// The figures of all makers, measured in turns: a slow while of the machine meets all of them.
std::vector<Figure> measured(const Group& group) {
    constexpr int kRounds = 7;
    std::vector<Figure> figures(makers().size());
    for (int round = 0; round < kRounds; ++round) {
        for (size_t i = 0; i < figures.size(); ++i) {
            figures[i].bytes = 0;
            const double begin = processorTime();
            for (const Image& picture : group.pictures)
                figures[i].bytes += makers()[i].size(picture);
            figures[i].milliseconds.push_back(processorTime() - begin);
        }
    }
    return figures;
}

void printHead() {
    std::printf("| %-31s | %8s |", "pictures", "number");
    for (const Maker& maker : makers())
        std::printf(" %6s ms | %6s KB |", maker.name, maker.name);
    std::printf("\n| ------------------------------- | -------: |");
    for (size_t i = 0; i < makers().size(); ++i)
        std::printf(" --------: | --------: |");
    std::printf("\n");
}

}  // namespace

int main() {
    const std::vector<Group> groups{
        gallery("the presets", "transparent"),
        gallery("the presets on a colour", "#23272E"),
        styled("titles, outline and soft shadow",
               R"({"color": "#FFFFFF", "stroke": {"size": 4, "color": "#1F4E9E", "position": "outside"},
                   "outerShadow": {"angle": 135, "distance": 6, "size": 8, "color": "#000000", "opacity": 0.6}})",
               84),
        styled("soft glows", R"({"color": "#FFFFFF", "outerGlow": {"size": 60, "color": "#33AAFF"}})",
               60),
        gradients(),
        {"like a photograph, 800 x 600", {photograph(800, 600)}},
        photographInLetters(),
        largeAndFlat()};
    printHead();
    for (const Group& group : groups) {
        std::printf("| %-31s | %8zu |", group.name.c_str(), group.pictures.size());
        for (Figure& figure : measured(group))
            std::printf(" %9.2f | %9.1f |", figure.median(), static_cast<double>(figure.bytes) / 1e3);
        std::printf("\n");
    }
}
