/// Texts on canvases, in markup and in stacks, as the program paints them.
#include <gtest/gtest.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <nlohmann/json.hpp>
#include <set>
#include <string>
#include <vector>

#include "compose/system/png_reader.h"
#include "program.h"

namespace vorelpaint {
namespace {

using Json = nlohmann::json;
using vorel_test::Outcome;
using vorel_test::readBytes;
using vorel_test::runVorelpaint;
using vorel_test::TempDir;
using vorelcompose::readPng;
using voreltext::Image;
using Words = std::vector<std::string>;

/// What is painted without a word on standard error.
Image painted(const TempDir& dir, Words arguments) {
    const std::string path = dir.file("painted.png");
    arguments.insert(arguments.end(), {"-o", path});
    const Outcome outcome = runVorelpaint(arguments);
    EXPECT_EQ(outcome.exitCode, 0);
    EXPECT_EQ(outcome.err, "");
    return readPng(path);
}

Json reported(Words arguments) {
    arguments.insert(arguments.end(), {"--report", "json"});
    const Outcome outcome = runVorelpaint(arguments);
    EXPECT_EQ(outcome.exitCode, 0) << outcome.err;
    return Json::parse(outcome.out);
}

/// One line on standard error, exit code 2, nothing written.
std::string faultOf(Words arguments) {
    const TempDir dir;
    arguments.insert(arguments.end(), {"-o", dir.file("a.png")});
    const Outcome outcome = runVorelpaint(arguments);
    EXPECT_EQ(outcome.exitCode, 2);
    EXPECT_EQ(outcome.out, "");
    EXPECT_EQ(std::count(outcome.err.begin(), outcome.err.end(), '\n'), 1) << outcome.err;
    EXPECT_TRUE(dir.list().empty());
    return outcome.err;
}

const uint8_t* pixelAt(const Image& image, int x, int y) {
    return &image.pixels[static_cast<size_t>(y * image.width + x) * 4];
}

std::set<std::string> coloursOf(const Image& image) {
    std::set<std::string> colours;
    for (int y = 0; y < image.height; ++y) {
        for (int x = 0; x < image.width; ++x) {
            const uint8_t* pixel = pixelAt(image, x, y);
            if (pixel[3] != 255) continue;
            char text[8];
            std::snprintf(text, sizeof text, "%02x%02x%02x", pixel[0], pixel[1], pixel[2]);
            colours.insert(text);
        }
    }
    return colours;
}

// --- canvas -------------------------------------------------------------------------------------------

TEST(Canvas, LineBoxes_HaveOneHeight) {
    const TempDir dir;
    std::set<int> heights;
    std::set<int> inks;
    for (const char* text : {"ace", "\xC3\x81pg", "\xE2\x80\x94"}) {
        heights.insert(painted(dir, {"--box", "line", text}).height);
        inks.insert(painted(dir, {text}).height);
    }
    EXPECT_EQ(heights.size(), 1U);
    EXPECT_EQ(inks.size(), 3U);
}

TEST(Canvas, HasTheSizeThatIsAskedFor) {
    const TempDir dir;
    const Image image = painted(dir, {"--width", "500", "--height", "200", "Hi"});
    EXPECT_EQ(image.width, 500);
    EXPECT_EQ(image.height, 200);
}

TEST(Canvas, Anchor_PlacesTheBoxWithinTheMargins) {
    const Words common{"--width", "400", "--height", "300", "--margin", "12", "--anchor"};
    const auto boxAt = [&](const char* anchor) {
        Words words = common;
        words.insert(words.end(), {anchor, "Hi"});
        return reported(words)["box"];
    };
    EXPECT_EQ(boxAt("top-left")["left"], 12);
    EXPECT_EQ(boxAt("top-left")["top"], 12);
    EXPECT_EQ(boxAt("bottom-right")["right"], 400 - 12);
    EXPECT_EQ(boxAt("bottom-right")["bottom"], 300 - 12);
    const Json centre = boxAt("center");
    const int left = centre["left"];
    const int right = centre["right"];
    EXPECT_LE(std::abs(left - (400 - right)), 1);
}

TEST(Canvas, Shrink_FindsTheLargestSizeThatFits) {
    const Words common{"--box", "line", "--width", "300", "--fit", "shrink", "Summer Sale"};
    const Json report = reported(common);
    const int size = report["size"];
    EXPECT_LT(size, 96);
    const auto widthAt = [&](int each) {
        const Json box =
            reported({"--box", "line", "--size", std::to_string(each), "Summer Sale"})["box"];
        return box["right"].get<int>() - box["left"].get<int>();
    };
    EXPECT_LE(widthAt(size), 300);
    EXPECT_GT(widthAt(size + 1), 300);
}

TEST(Canvas, Shrink_TakesATextThatCouldNotBeSetInItsOwnSize) {
    const std::string wide(400, 'm');
    EXPECT_NE(faultOf({wide}).find("more than 16384 pixels wide"), std::string::npos);
    const Json report = reported({"--width", "3000", "--fit", "shrink", wide});
    EXPECT_GT(report["size"], 1);
    EXPECT_LT(report["size"], 10);
    EXPECT_EQ(faultOf({"--width", "3000", "--fit", "shrink", "one\ntwo\033"}),
              "vorelpaint: the text has the control character U+001B in line 2, character 4\n");
}

TEST(Canvas, TextThatFits_IsNotShrunk) {
    EXPECT_EQ(reported({"--width", "3000", "--fit", "shrink", "Hi"})["size"], 96);
}

TEST(Canvas, Wrap_BreaksLinesAtBlanks) {
    const Json report = reported({"--width", "400", "--margin", "10", "--fit", "wrap", "--size", "40",
                                  "The quick brown fox jumps"});
    std::string joined;
    for (const Json& line : report["lines"]) {
        joined += line["text"].get<std::string>();
        const int width = line["ink"]["right"].get<int>() - line["ink"]["left"].get<int>();
        EXPECT_LE(width, 380);
    }
    EXPECT_GT(report["lines"].size(), 1U);
    joined.erase(std::remove(joined.begin(), joined.end(), ' '), joined.end());
    EXPECT_EQ(joined, "Thequickbrownfoxjumps");
}

TEST(Canvas, TooSmallForAGlyph_IsRefused) {
    const std::string fault =
        "vorelpaint: the canvas is too small for one glyph: that of U+0057 at line 1, "
        "character 2 is ";
    EXPECT_EQ(faultOf({"--width", "60", "iW"}).rfind(fault, 0), 0U);
    EXPECT_EQ(faultOf({"--height", "40", "aW"}).rfind("vorelpaint: the canvas is too small", 0), 0U);
    EXPECT_NE(faultOf({"--width", "20", "--fit", "wrap", "W"}).find("wider than 20"), std::string::npos);
    EXPECT_NE(faultOf({"--width", "1", "--fit", "shrink", "WWWWWWWW"}).find("at any size"),
              std::string::npos);
    EXPECT_NE(faultOf({"--width", "100", "--margin", "50", "W"}).find("leave no room"),
              std::string::npos);
}

TEST(Canvas, WhatIsCutOff_IsNoted_AndAnErrorWhenStrict) {
    const Words wide{"--width", "200", "--anchor", "left", "A wide text"};
    const TempDir dir;
    Words words = wide;
    words.insert(words.end(), {"-o", dir.file("a.png")});
    const Outcome outcome = runVorelpaint(words);
    EXPECT_EQ(outcome.exitCode, 0);
    EXPECT_EQ(outcome.err.rfind(
                  "vorelpaint: note: the picture cuts pixels of the text or its effects off: ", 0),
              0U);
    Words strict = wide;
    strict.insert(strict.begin(), "--strict");
    EXPECT_EQ("vorelpaint: note: " + faultOf(strict).substr(12), outcome.err);
}

TEST(Canvas, PartOfAPicture_IsThatOfTheWhole) {
    const TempDir dir;
    const Image whole =
        painted(dir, {"--preset", "subtitle", "--width", "600", "--height", "200", "Same"});
    const Image alone = painted(dir, {"--preset", "subtitle", "--padding", "0", "Same"});
    const Json report = reported({"--preset", "subtitle", "--width", "600", "--height", "200", "Same"});
    const int left = report["ink"]["left"].get<int>() - report["margins"]["left"].get<int>();
    const int top = report["ink"]["top"].get<int>() - report["margins"]["top"].get<int>();
    for (int y = 0; y < alone.height; ++y) {
        ASSERT_TRUE(std::equal(pixelAt(alone, 0, y), pixelAt(alone, 0, y) + alone.width * 4,
                               pixelAt(whole, left, top + y)))
            << y;
    }
}

// --- report -------------------------------------------------------------------------------------------

TEST(Report, TellsWhatIsPainted) {
    const TempDir dir;
    const std::string path = dir.file("a.png");
    const Outcome outcome = runVorelpaint({"--report", "json", "--preset", "subtitle", "-o", path,
                                           "One\n\xD7\xA9\xD7\x9C\xD7\x95\xD7\x9D"});
    ASSERT_EQ(outcome.exitCode, 0) << outcome.err;
    EXPECT_EQ(std::count(outcome.out.begin(), outcome.out.end(), '\n'), 1) << "one line";
    const Json report = Json::parse(outcome.out);
    const Image image = readPng(path);
    EXPECT_EQ(report["output"], path);
    EXPECT_EQ(report["width"], image.width);
    EXPECT_EQ(report["height"], image.height);
    EXPECT_EQ(report["size"], 96);
    EXPECT_EQ(report["baseline"], report["lines"][0]["baseline"]);
    EXPECT_EQ(report["lines"][0]["text"], "One");
    EXPECT_EQ(report["lines"][0]["direction"], "left-to-right");
    EXPECT_EQ(report["lines"][1]["direction"], "right-to-left");
    EXPECT_EQ(report["fonts"], Json::array({"DejaVu Sans Book"}));
    EXPECT_TRUE(report["missing"].empty());
    EXPECT_EQ("key " + report["key"].get<std::string>() + "\n",
              runVorelpaint({"--preset", "subtitle", "--print-key"}).out);
    const Json& margins = report["margins"];
    EXPECT_EQ(report["ink"]["left"].get<int>() - margins["left"].get<int>(), 8) << "the padding";
    EXPECT_EQ(report["ink"]["bottom"].get<int>() + margins["bottom"].get<int>() + 8, image.height);
}

TEST(Report, Baseline_IsWhereLettersStand) {
    const TempDir dir;
    const Image image = painted(dir, {"--color", "#FF0000", "H"});
    const int baseline = reported({"H"})["baseline"];
    int lowest = 0;
    for (int y = 0; y < image.height; ++y) {
        for (int x = 0; x < image.width; ++x) {
            if (pixelAt(image, x, y)[3] > 127) lowest = y;
        }
    }
    EXPECT_EQ(lowest + 1, baseline);
}

TEST(Report, MissingCharacters_AreNamedWithTheirPlaces) {
    const Json report = reported({"a\nb\xF0\x93\x80\x80\xF0\x93\x80\x80"});
    ASSERT_EQ(report["missing"].size(), 1U);
    EXPECT_EQ(report["missing"][0]["code"], "U+13000");
    EXPECT_EQ(report["missing"][0]["count"], 2);
    EXPECT_EQ(report["missing"][0]["first"], "line 2, character 2");
    EXPECT_EQ(report["missing"][0]["text"], "\xF0\x93\x80\x80");
}

TEST(Report, Batch_HasALineForEachJob) {
    const TempDir dir;
    const std::string jobs =
        dir.write("jobs.jsonl", R"({"text": "A", "output": ")" + dir.file("a.png") + R"("})" + "\n" +
                                    R"({"text": "B", "size": 20, "output": ")" + dir.file("b.png") +
                                    R"("})" + "\n");
    const Outcome outcome = runVorelpaint({"--batch", jobs, "--report", "json"});
    EXPECT_EQ(outcome.exitCode, 0) << outcome.err;
    const size_t end = outcome.out.find('\n');
    EXPECT_EQ(Json::parse(outcome.out.substr(0, end))["output"], dir.file("a.png"));
    EXPECT_EQ(Json::parse(outcome.out.substr(end))["size"], 20);
}

TEST(Report, Batch_DoesNotMixWithAPicture) {
    const TempDir dir;
    const std::string jobs = dir.write("jobs.jsonl", R"({"text": "A", "output": "/dev/stdout"})");
    const Outcome outcome = runVorelpaint({"--batch", jobs, "--report", "json"});
    EXPECT_EQ(outcome.exitCode, 2);
    EXPECT_EQ(outcome.out, "");
    EXPECT_EQ(outcome.err,
              "vorelpaint: line 1: standard output cannot take both the picture and what is printed\n"
              "vorelpaint: 1 of 1 jobs failed\n");
    EXPECT_EQ(runVorelpaint({"--batch", jobs}).out.substr(1, 3), "PNG");
}

TEST(Strict, MissingCharacter_IsAnError) {
    EXPECT_EQ(
        faultOf({"--strict", "a\xF0\x93\x80\x80"}),
        "vorelpaint: no font has U+13000 (line 1, character 2); its sign for missing characters is "
        "painted\n");
}

TEST(Notes, FaultStandsAlone) {
    const TempDir dir;
    const auto linesOf = [](const Words& arguments) {
        const Outcome outcome = runVorelpaint(arguments);
        EXPECT_EQ(outcome.exitCode, 2);
        return std::count(outcome.err.begin(), outcome.err.end(), '\n');
    };
    const std::string missing = "a\xF0\x93\x80\x80";
    EXPECT_EQ(linesOf({"-o", dir.file("none/a.png"), missing}), 1) << "what cannot be written";
    EXPECT_EQ(linesOf({"--sheet", "-o", dir.file("none/a.png"), missing}), 1);
    const std::string style = dir.write("a.json", R"({"version": 2, "looks": [
        {"stroke": {"size": "40%", "color": "#000", "position": "outside"}},
        {"pattern": {"image": "none.png"}}]})");
    EXPECT_EQ(linesOf({"--style", style, "--size", "300", "--print-key"}), 1) << "and no text";
    const std::string glow = dir.write("b.json", R"({"outerGlow": {"size": 100, "color": "#000"}})");
    EXPECT_EQ(linesOf({"--style", glow, "--size", "23", "--width", "900", "--height", "900", "-o",
                       dir.file("a.png"), missing + std::string(720, 'm')}),
              1)
        << "what is too large with its effects";
    EXPECT_EQ(dir.list(), (Words{"a.json", "b.json"}));
}

TEST(Notes, OfASheet_AreToldOnce) {
    const TempDir dir;
    const auto notesOf = [&](const Words& words, const char* note) {
        Words arguments{"--sheet", "-o", dir.file("a.png")};
        arguments.insert(arguments.end(), words.begin(), words.end());
        const Outcome outcome = runVorelpaint(arguments);
        EXPECT_EQ(outcome.exitCode, 0) << outcome.err;
        int count = 0;
        for (size_t at = outcome.err.find(note); at != std::string::npos;
             at = outcome.err.find(note, at + 1))
            ++count;
        return count;
    };
    EXPECT_EQ(notesOf({"--sizes", "20,40", "a\xF0\x93\x80\x80"}, "no font has U+13000"), 1);
    const std::string high = "\xC3\x81\n\xC3\x81";
    EXPECT_EQ(notesOf({"--box", "line", "--line-height", "0.5", high}, "cuts pixels"), 1);
    EXPECT_EQ(notesOf({"--box", "ink", "--line-height", "0.5", high}, "cuts pixels"), 0);
}

TEST(Strict, Batch_FailsTheJobAlone) {
    const TempDir dir;
    const std::string jobs = dir.write(
        "jobs.jsonl", R"({"text": "\ud80c\udc00", "output": ")" + dir.file("a.png") + R"("})" + "\n" +
                          R"({"text": "B", "output": ")" + dir.file("b.png") + R"("})" + "\n");
    const Outcome outcome = runVorelpaint({"--batch", jobs, "--strict"});
    EXPECT_EQ(outcome.exitCode, 2);
    EXPECT_EQ(dir.list(), (Words{"b.png", "jobs.jsonl"}));
}

TEST(Strict, LengthBeyondTheLimit_IsAnError) {
    const TempDir dir;
    const std::string style = dir.write(
        "wide.json",
        R"({"version": 2, "stroke": {"size": "40%", "color": "#000", "position": "outside"}})");
    const Outcome outcome =
        runVorelpaint({"--style", style, "--size", "300", "-o", dir.file("a.png"), "I"});
    EXPECT_EQ(outcome.exitCode, 0);
    EXPECT_EQ(outcome.err,
              "vorelpaint: note: stroke.size: 120 pixels are more than the library's 100; painted "
              "with 100\n");
    EXPECT_EQ(faultOf({"--strict", "--style", style, "--size", "300", "I"}),
              "vorelpaint: stroke.size: 120 pixels are more than the library's 100; painted with 100\n");
}

TEST(Notes, LengthsBeyondTheLimitByTheScale_AreToldWithTheLookTheyAreIn) {
    const TempDir dir;
    const std::string style = dir.write("wide.json", R"({"version": 2, "looks": [
        {"stroke": {"size": 60, "color": "#000", "position": "outside"}},
        {"outerShadow": {"angle": 90, "distance": "10%", "size": 4, "color": "#000"}}]})");
    const auto notesAt = [&](const std::string& scale) {
        const Outcome outcome = runVorelpaint(
            {"--style", style, "--size", "96", "--effect-scale", scale, "-o", dir.file("a.png"), "I"});
        EXPECT_EQ(outcome.exitCode, 0);
        return outcome.err;
    };
    // 60 * 1.66 is 99.6, rounded 100; 9.6 * 10.5 is 100.8.
    EXPECT_EQ(notesAt("1.66"), "");
    EXPECT_EQ(notesAt("1.7"),
              "vorelpaint: note: looks[0].stroke.size: 102 pixels are more than the library's 100; "
              "painted with 100\n");
    EXPECT_EQ(notesAt("10.5"),
              "vorelpaint: note: looks[0].stroke.size: 630 pixels are more than the library's 100; "
              "painted with 100\n"
              "vorelpaint: note: looks[1].outerShadow.distance: 101 pixels are more than the library's "
              "100; painted with 100\n");
}

// --- markup -------------------------------------------------------------------------------------------

TEST(Markup, ColoursItsWords) {
    const TempDir dir;
    const Image image = painted(dir, {"--markup", "--color", "#0000FF", "I <c #F00>I</c> &lt;"});
    const std::set<std::string> colours = coloursOf(image);
    EXPECT_EQ(colours.count("0000ff"), 1U);
    EXPECT_EQ(colours.count("ff0000"), 1U);
    EXPECT_EQ(reported({"--markup", "I <c #F00>I</c> &lt;"})["lines"][0]["text"], "I I <");
}

TEST(Markup, InTheFillsColour_ChangesNothing) {
    const TempDir dir;
    const Words look{"--preset", "subtitle", "--markup"};
    const auto of = [&](const char* text) {
        Words words = look;
        words.emplace_back(text);
        return painted(dir, words).pixels;
    };
    EXPECT_EQ(of("to<c #FFFFFF>get</c>her"), of("together"));
    EXPECT_NE(of("to<c #FF0000>get</c>her"), of("together"));
}

TEST(Markup, ThatDoesNotClose_IsRefusedWithItsPlace) {
    EXPECT_EQ(faultOf({"--markup", "one\ntwo <c #f80>three"}),
              "vorelpaint: markup, line 2, character 5: the tag does not close; </c> is missing\n");
    const TempDir dir;
    EXPECT_EQ(coloursOf(painted(dir, {"one <c #f80>"})), std::set<std::string>{"000000"})
        << "without --markup";
}

TEST(Markup, Places_AreThoseOfTheWrittenText) {
    const std::string missing = "<c #f80>a</c>\xF0\x93\x80\x80";
    EXPECT_EQ(reported({"--markup", missing})["missing"][0]["first"], "line 1, character 14");
    EXPECT_NE(faultOf({"--strict", "--markup", missing}).find("(line 1, character 14)"),
              std::string::npos);
    EXPECT_NE(faultOf({"--width", "60", "--markup", "i<c #f80>W</c>"}).find("line 1, character 10"),
              std::string::npos);
}

TEST(Markup, CoveredByAnOpaqueEffect_IsNoted) {
    const auto errorsOf = [](const std::string& style) {
        const TempDir dir;
        return runVorelpaint({"--markup", "--style", dir.write("g.json", style), "-o", dir.file("a.png"),
                              "a <c #f80>b</c>"})
            .err;
    };
    const std::string note =
        "vorelpaint: note: the look's linearGradient covers the colours of the markup\n";
    const auto gradient = [](const std::string& stop, const std::string& opacity) {
        return R"({"linearGradient": {"angle": 90, "opacity": )" + opacity +
               R"(, "gradient": [{"color": "#00F", "location": 0, "opacity": )" + stop + "}]}}";
    };
    EXPECT_EQ(errorsOf(gradient("1", "1")), note);
    EXPECT_EQ(errorsOf(gradient("0.9", "1")), "");
    EXPECT_EQ(errorsOf(gradient("1", "0.9")), "");
    const TempDir dir;
    EXPECT_EQ(
        runVorelpaint({"--markup", "--preset", "candy", "-o", dir.file("a.png"), "<c #f80>b</c>"}).err,
        "vorelpaint: note: the look's pattern covers the colours of the markup\n");
}

TEST(Markup, UnderATranslucentGradient_IsSeen) {
    const TempDir dir;
    const std::string style = dir.write("g.json", R"({"radialGradient": {"gradient": [
        {"color": "#00F", "location": 0}, {"color": "#00F", "location": 1, "opacity": 0.5}]}})");
    const Words look{"--markup", "--style", style};
    const auto of = [&](const char* text) {
        Words words = look;
        words.emplace_back(text);
        return painted(dir, words).pixels;
    };
    EXPECT_NE(of("a <c #f80>b</c>"), of("a b"));
}

// --- stacks -------------------------------------------------------------------------------------------

constexpr const char* kStack = R"({"version": 2, "looks": [
    {"color": "#0000FF", "offset": {"x": "10%", "y": "10%"}},
    {"color": "#00FF00", "stroke": {"size": "6%", "color": "#00FF00", "position": "outside"}},
    {"color": "#FF0000"}]})";

TEST(Stack, LooksLieOverOneAnother) {
    const TempDir dir;
    const std::string style = dir.write("stack.json", kStack);
    const Image image = painted(dir, {"--style", style, "--size", "100", "I"});
    const std::set<std::string> colours = coloursOf(image);
    EXPECT_EQ(colours.count("0000ff"), 1U) << "the shadow shows";
    EXPECT_EQ(colours.count("00ff00"), 1U) << "the outline shows";
    const uint8_t* middle = pixelAt(image, (image.width - 4) / 2, image.height / 2);
    EXPECT_EQ(middle[0], 255) << "the text lies on top";
    EXPECT_EQ(runVorelpaint({"--style", style, "--size", "100", "--print-margins"}).out,
              "margins left 6 top 6 right 10 bottom 10\n");
}

TEST(Stack, Colour_IsThatOfTheTopmostFill) {
    const TempDir dir;
    const std::string style = dir.write("stack.json", kStack);
    const std::set<std::string> colours =
        coloursOf(painted(dir, {"--style", style, "--color", "#FFFF00", "I"}));
    EXPECT_EQ(colours.count("ffff00"), 1U);
    EXPECT_EQ(colours.count("ff0000"), 0U);
    EXPECT_EQ(colours.count("0000ff"), 1U);
}

TEST(Stack, Lengths_FollowTheSize) {
    const TempDir dir;
    const std::string style = dir.write("stack.json", kStack);
    EXPECT_EQ(runVorelpaint({"--style", style, "--size", "200", "--print-margins"}).out,
              "margins left 12 top 12 right 20 bottom 20\n");
    EXPECT_EQ(reported({"--style", style, "--size", "200", "I"})["margins"]["right"], 20);
}

TEST(Stack, EachLookIsExplained) {
    const TempDir dir;
    const Outcome outcome =
        runVorelpaint({"--style", dir.write("stack.json", kStack), "--explain", "I"});
    EXPECT_EQ(outcome.exitCode, 0);
    for (const char* part :
         {"looks       3, the last on top", "Look 3 of 3, the topmost: ", "Look 2 of 3: ",
          "Look 1 of 3, the lowest: moved by 10, 10", "fonts       'DejaVu Sans Book'"}) {
        EXPECT_NE(outcome.out.find(part), std::string::npos) << part;
    }
}

TEST(Stack, InABatch_IsAStyleLikeOthers) {
    const TempDir dir;
    std::string stack = kStack;
    stack.erase(std::remove(stack.begin(), stack.end(), '\n'), stack.end());
    const std::string jobs = dir.write("jobs.jsonl", R"({"text": "I", "output": ")" + dir.file("a.png") +
                                                         R"(", "style": )" + stack + "}\n");
    EXPECT_EQ(runVorelpaint({"--batch", jobs}).exitCode, 0);
    runVorelpaint({"--style", dir.write("stack.json", kStack), "-o", dir.file("b.png"), "I"});
    EXPECT_EQ(readBytes(dir.file("a.png")), readBytes(dir.file("b.png")));
}

TEST(Sheet, Sizes_AreColumns) {
    const TempDir dir;
    const auto sheet = [&](const char* sizes) {
        const std::string path = dir.file("sheet.png");
        const Outcome outcome = runVorelpaint({"--sheet", "--sizes", sizes, "-o", path, "Ty"});
        EXPECT_EQ(outcome.exitCode, 0) << outcome.err;
        return readPng(path);
    };
    const Image both = sheet("20,40");
    const Image wider = sheet("20,40,40");
    EXPECT_EQ(both.height, wider.height) << "a row for each preset, as high as its highest cell";
    EXPECT_GT(wider.width, both.width);
}

}  // namespace
}  // namespace vorelpaint
