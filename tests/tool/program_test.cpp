#include "program.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <string>
#include <vector>

#include "compose/system/png_reader.h"
#include "voreleffect/VFVersion.h"

namespace vorelpaint {
namespace {

using vorel_test::Outcome;
using vorel_test::readBytes;
using vorel_test::runVorelpaint;
using vorel_test::runVorelpaintInto;
using vorel_test::TempDir;
using vorelcompose::readPng;
using voreltext::Image;
using Words = std::vector<std::string>;

const std::string kPngSignature = "\x89PNG\r\n\x1A\n";

class Program : public ::testing::Test {
  protected:
    /// Paints with these arguments into a file and reads it back.
    Image paint(Words arguments) {
        const std::string path = mDir.file("picture.png");
        arguments.insert(arguments.begin(), {"-o", path});
        const Outcome outcome = runVorelpaint(arguments);
        EXPECT_EQ(outcome.exitCode, 0);
        EXPECT_EQ(outcome.err, "");
        return readPng(path);
    }

    /// Runs with these arguments, which must fail in the one way that failures have: exit code 2,
    /// one line that contains `fault`, nothing printed and no file left beside what was there.
    void expectFailure(Words arguments, const std::string& fault) {
        SCOPED_TRACE(::testing::PrintToString(arguments));
        const Words before = mDir.list();
        const bool hasOutput = std::find(arguments.begin(), arguments.end(), "-o") != arguments.end();
        if (!hasOutput) arguments.insert(arguments.begin(), {"-o", mDir.file("out.png")});
        const Outcome outcome = runVorelpaint(arguments);
        EXPECT_EQ(outcome.exitCode, 2);
        EXPECT_EQ(outcome.out, "");
        EXPECT_EQ(outcome.err.rfind("vorelpaint: ", 0), 0U) << outcome.err;
        EXPECT_NE(outcome.err.find(fault), std::string::npos) << outcome.err;
        EXPECT_EQ(std::count(outcome.err.begin(), outcome.err.end(), '\n'), 1) << outcome.err;
        EXPECT_EQ(outcome.err.back(), '\n');
        EXPECT_EQ(mDir.list(), before);
    }

    std::string writeStyle(const std::string& json) { return mDir.write("style.json", json); }

    TempDir mDir;
};

/// Alpha of the pixel, row by row.
std::vector<uint8_t> alphaOf(const Image& image) {
    std::vector<uint8_t> alpha;
    for (size_t at = 3; at < image.pixels.size(); at += 4)
        alpha.push_back(image.pixels[at]);
    return alpha;
}

TEST_F(Program, PlainText_IsItsInkInItsColour) {
    const Image image = paint({"--padding", "0", "--color", "#3366CC", "I"});
    bool opaque = false;
    for (size_t at = 0; at < image.pixels.size(); at += 4) {
        if (image.pixels[at + 3] != 255) continue;
        opaque = true;
        EXPECT_EQ(image.pixels[at], 0x33);
        EXPECT_EQ(image.pixels[at + 1], 0x66);
        EXPECT_EQ(image.pixels[at + 2], 0xCC);
    }
    EXPECT_TRUE(opaque);
    const auto ink = std::count_if(image.pixels.begin(), image.pixels.begin() + image.width * 4,
                                   [](uint8_t byte) { return byte != 0; });
    EXPECT_GT(ink, 0) << "the first row holds the top of the letter";
}

TEST_F(Program, Padding_GrowsEverySide) {
    const Image tight = paint({"--padding", "0", "Ag"});
    const Image padded = paint({"--padding", "5", "Ag"});
    EXPECT_EQ(padded.width, tight.width + 10);
    EXPECT_EQ(padded.height, tight.height + 10);
}

TEST_F(Program, Picture_IsAsMuchLargerAsTheMarginsSay) {
    const std::string style = writeStyle(
        R"({"outerShadow": {"angle": 0, "distance": 10, "size": 10, "color": "#000000"},
            "stroke": {"size": 7, "color": "#000000", "position": "outside"}})");
    EXPECT_EQ(runVorelpaint({"--style", style, "--print-margins"}).out,
              "margins left 20 top 10 right 7 bottom 10\n");
    const Image plain = paint({"--padding", "0", "Ag"});
    const Image decorated = paint({"--padding", "0", "--style", style, "Ag"});
    EXPECT_EQ(decorated.width, plain.width + 27);
    EXPECT_EQ(decorated.height, plain.height + 20);
}

TEST_F(Program, SizeDoubled_AboutDoublesThePicture) {
    const Image small = paint({"--padding", "0", "--size", "50", "Hg"});
    const Image large = paint({"--padding", "0", "--size", "100", "Hg"});
    EXPECT_NEAR(large.width, 2 * small.width, 4);
    EXPECT_NEAR(large.height, 2 * small.height, 4);
}

TEST_F(Program, LineFeeds_StackLines) {
    const Image one = paint({"--padding", "0", "--size", "60", "Hg"});
    const Image three = paint({"--padding", "0", "--size", "60", "Hg\nHg\nHg"});
    EXPECT_EQ(three.width, one.width);
    EXPECT_NEAR(three.height - one.height, 2 * 60 * 1.164, 3) << "DejaVu Sans sets lines 1.164 em apart";
}

TEST_F(Program, TextFileAndStandardInput_PaintTheSame) {
    const std::string file = mDir.write("text", "two\nlines\n");
    const std::string output = mDir.file("stdin.png");
    const Image fromFile = paint({"--text-file", file});
    EXPECT_EQ(runVorelpaint({"--text-file", "-", "-o", output}, "two\nlines\n").exitCode, 0);
    EXPECT_EQ(readPng(output).pixels, fromFile.pixels);
    EXPECT_EQ(paint({"two\nlines"}).pixels, fromFile.pixels);
}

TEST_F(Program, StandardOutput_TakesTheSameBytes) {
    const Outcome outcome = runVorelpaint({"-o", "-", "Ag"});
    EXPECT_EQ(outcome.exitCode, 0);
    EXPECT_EQ(outcome.out.substr(0, kPngSignature.size()), kPngSignature);
    paint({"Ag"});
    EXPECT_EQ(outcome.out, readBytes(mDir.file("picture.png")));
}

TEST_F(Program, Opacity_ThinsTheFill) {
    const std::vector<uint8_t> full = alphaOf(paint({"Ag"}));
    const std::vector<uint8_t> half = alphaOf(paint({"--opacity", "0.5", "Ag"}));
    EXPECT_EQ(*std::max_element(full.begin(), full.end()), 255);
    EXPECT_NEAR(*std::max_element(half.begin(), half.end()), 128, 1);
}

TEST_F(Program, CommandLine_OverrulesTheStyle) {
    const std::string style = writeStyle(R"({"color": "#112233", "textOpacity": 0.5})");
    EXPECT_EQ(
        runVorelpaint({"--style", style, "--color", "#445566", "--opacity", "1", "--print-key"}).out,
        runVorelpaint({"--color", "#445566", "--print-key"}).out);
    EXPECT_EQ(runVorelpaint({"--style", style, "--print-key"}).out,
              runVorelpaint({"--color", "#112233", "--opacity", "0.5", "--print-key"}).out);
}

TEST_F(Program, PrintKey_SpellsTheBytesInHexadecimal) {
    EXPECT_EQ(runVorelpaint({"--color", "#123456", "--print-key"}).out, "key 548f8f818283848586\n");
}

TEST_F(Program, Background_FillsThePicture) {
    const Image image = paint({"--background", "#102030", "Ag"});
    EXPECT_EQ(image.pixels[0], 0x10);
    EXPECT_EQ(image.pixels[1], 0x20);
    EXPECT_EQ(image.pixels[2], 0x30);
    const std::vector<uint8_t> alpha = alphaOf(image);
    EXPECT_EQ(*std::min_element(alpha.begin(), alpha.end()), 255);
    EXPECT_EQ(paint({"Ag"}).pixels[3], 0) << "without one the corner is transparent";
}

TEST_F(Program, MixedDirections_PaintLikeTheirVisualOrder) {
    const std::string alef = "\xD7\x90";
    const std::string bet = "\xD7\x91";
    const std::string override = "\xE2\x80\xAD";
    EXPECT_EQ(paint({alef + bet}).pixels, paint({override + bet + alef}).pixels);
    EXPECT_NE(paint({alef + bet}).pixels, paint({override + alef + bet}).pixels);
}

TEST_F(Program, MissingCharacters_AreAWarning) {
    const Outcome outcome = runVorelpaint({"-o", mDir.file("a.png"), "A\xF0\x93\x80\x80"});
    EXPECT_EQ(outcome.exitCode, 0);
    EXPECT_EQ(outcome.err,
              "vorelpaint: note: no font has U+13000 (line 1, character 2); its sign for missing "
              "characters is "
              "painted\n");
}

TEST_F(Program, EffectsWithoutACore_AreAWarningEach) {
    const std::string style = writeStyle(
        R"({"bevel": {"size": 1, "angle": 0, "altitude": 0, "highlightColor": "#000000", "shadowColor": "#000000"}})");
    const Outcome outcome = runVorelpaint({"--style", style, "-o", mDir.file("a.png"), "A"});
    EXPECT_EQ(outcome.exitCode, 0);
    EXPECT_EQ(outcome.err, "vorelpaint: note: the library has no core for bevel; it is not painted\n");
    EXPECT_EQ(readBytes(mDir.file("a.png")), (paint({"A"}), readBytes(mDir.file("picture.png"))));
}

TEST_F(Program, PatternImage_IsFoundBesideTheStyle) {
    std::filesystem::copy_file(std::string(VORELPAINT_PRESETS) + "/tiles.png", mDir.file("tiles.png"));
    paint({"--style", writeStyle(R"({"pattern": {"image": "tiles.png"}})"), "Ag"});
    const std::string style = writeStyle(R"({"pattern": {"image": "other.png"}})");
    expectFailure({"--style", style, "Ag"}, "style '" + style + "': pattern.image: '" +
                                                mDir.file("other.png") + "' does not exist");
}

TEST_F(Program, Help_ShowsExamples) {
    const Outcome outcome = runVorelpaint({"--help"});
    EXPECT_EQ(outcome.exitCode, 0);
    EXPECT_NE(outcome.out.find("Examples:"), std::string::npos);
    EXPECT_EQ(outcome.err, "");
}

TEST_F(Program, Version_IsOneLine) {
    const Outcome outcome = runVorelpaint({"--version"});
    EXPECT_EQ(outcome.exitCode, 0);
    EXPECT_EQ(outcome.out, std::string("vorelpaint ") + VOREL_VERSION_STRING + "\n");
}

TEST_F(Program, BadArguments_FailInOneLine) {
    expectFailure({"--no-such-option", "A"}, "--no-such-option");
    expectFailure({"--size", "big", "A"}, "--size");
    expectFailure({"--size", "0", "A"}, "--size");
    expectFailure({"--opacity", "1.5", "A"}, "--opacity");
    expectFailure({"--opacity", "nan", "A"}, "--opacity");
    expectFailure({"--effect-scale", "0", "A"}, "from 0.05 to 20");
    expectFailure({"--color", "red", "A"}, "--color: 'red' is no colour");
    expectFailure({"--align", "middle", "A"}, "--align: 'middle'");
    expectFailure({"--background", "white", "A"}, "--background: 'white'");
    expectFailure({"--padding", "-1", "A"}, "--padding");
    expectFailure({"A", "B"}, "B");
    expectFailure({"--style"}, "--style");
}

TEST_F(Program, EmptyNames_AreNoNames) {
    expectFailure({"--style", "", "A"}, "cannot read ''");
    expectFailure({"--preset", "", "A"}, "no preset ''");
    expectFailure({"--text-file", ""}, "cannot read ''");
    expectFailure({"-o", "", "A"}, "cannot write ''");
}

TEST_F(Program, ContradictoryArguments_FailInOneLine) {
    expectFailure({"--text-file", "-", "A"}, "--text-file");
    expectFailure({"--style", "a", "--preset", "gold", "A"}, "--preset");
    expectFailure({"-o", "-", "--print-key", "A"}, "standard output");
    expectFailure({"-o", "/dev/stdout", "--print-key", "A"}, "standard output");
    expectFailure({}, "give TEXT");
    EXPECT_EQ(runVorelpaint({"A"}).exitCode, 2) << "no output named";
}

TEST_F(Program, TextWithoutInk_IsRefused) {
    expectFailure({""}, "no visible character");
    expectFailure({" \n "}, "no visible character");
    expectFailure({"--text-file", "/dev/null"}, "no visible character");
}

TEST_F(Program, ControlCharacters_AreRefusedWithTheirPlace) {
    const std::string fault = "the text has the control character U+001B in line 2, character 3";
    expectFailure({"A\nbc\x1B[0m"}, fault);
    expectFailure({"--sheet", "A\nbc\x1B[0m"}, fault);
    expectFailure({"--text-file", mDir.write("t", "A\r\nbc\x1B")}, fault);
}

TEST_F(Program, CarriageReturns_EndLines) {
    const std::vector<uint8_t> expected = paint({"--text-file", mDir.write("t", "one\ntwo\n")}).pixels;
    EXPECT_EQ(paint({"--text-file", mDir.write("t", "one\rtwo\r")}).pixels, expected);
    EXPECT_EQ(paint({"--text-file", mDir.write("t", "one\r\ntwo\r\n")}).pixels, expected);
}

TEST_F(Program, InvalidUtf8_IsRefusedWithItsPlace) {
    expectFailure({"ab\xFF"}, "not valid UTF-8 at byte 3");
    expectFailure({"--text-file", mDir.write("t", "\xC3")}, "not valid UTF-8 at byte 1");
}

TEST_F(Program, Fonts_ThatCannotBeUsedAreNamed) {
    expectFailure({"--font", "No Such Family", "A"}, "no font file or family 'No Such Family'");
    expectFailure({"--font", "/no/such/font.ttf", "A"}, "'/no/such/font.ttf'");
    const std::string noFont = mDir.write("font.ttf", "not a font");
    expectFailure({"--font", noFont, "A"}, "'" + noFont + "' is no font");
    expectFailure({"--font", "", "A"}, "no font file or family ''");
    expectFailure({"--font", "DejaVu Sans:blod", "A"}, "font 'DejaVu Sans:blod': 'blod' is no style");
}

TEST_F(Program, FontsWithoutAConfiguration_AreNoReasonForASecondLine) {
    ::setenv("FONTCONFIG_FILE", "/nonexistent", 1);
    expectFailure({"--font", "No Such Family", "A"}, "no font file or family 'No Such Family'");
    ::unsetenv("FONTCONFIG_FILE");
}

TEST_F(Program, TextThatBeginsWithADash_StandsBehindTwo) {
    EXPECT_EQ(paint({"--", "-40"}).pixels, paint({"\xE2\x80\x8E-40"}).pixels)
        << "a mark without ink makes it no option";
}

TEST_F(Program, Styles_ThatCannotBeReadAreNamed) {
    expectFailure({"--style", mDir.file("none.json"), "A"}, "'" + mDir.file("none.json") + "'");
    expectFailure({"--style", mDir.path().string(), "A"}, "Is a directory");
    expectFailure({"--style", "/dev/zero", "A"}, "longer than");
    const std::string style = writeStyle("{\n\"stroke\": {\"size\": 200}\n}");
    expectFailure({"--style", style, "A"}, style + "': stroke.size: 200 is out of range, 0 to 100");
    expectFailure({"--preset", "none", "A"}, "no preset 'none'; there are");
    expectFailure({"--preset", "glod", "A"}, "no preset 'glod'; did you mean gold? There are aurora, ");
    expectFailure({"--preset", "../presets/gold", "A"}, "no preset");
}

TEST_F(Program, ControlCharactersInANameStayOnTheOneLine) {
    expectFailure({"--style", "a\nb\x1B[2J", "A"}, "cannot read 'a b [2J'");
    expectFailure({"--style", "a\xC2\x9B\x32J", "A"}, "cannot read 'a<U+009B>2J'");
    expectFailure({"--style", "a\xE2\x80\xAEgpj\xFF", "A"}, "cannot read 'a<U+202E>gpj<FF>'");
}

TEST_F(Program, TooLargePictures_AreRefused) {
    expectFailure({"--size", "1001", "A"}, "--size");
    expectFailure({"--size", "1000", std::string(40, 'M')}, "pixels wide or high");
    std::string lines;
    for (int i = 0; i < 12; ++i)
        lines += "MMMMMMMMMMMM\n";
    expectFailure({"--size", "1000", lines}, "the picture would be");
    expectFailure({"--text-file", "/dev/zero"}, "longer than");
}

TEST_F(Program, OutputThatCannotBeWritten_IsNamed) {
    expectFailure({"-o", mDir.file("no/such/dir.png"), "A"}, "no/such/dir.png");
    expectFailure({"-o", mDir.path().string(), "A"}, "Is a directory");
    expectFailure({"-o", "/dev/full", "A"}, "/dev/full");
    const Outcome outcome = runVorelpaintInto("/dev/full", {"-o", "-", "A"});
    EXPECT_EQ(outcome.exitCode, 2);
    EXPECT_NE(outcome.err.find("standard output"), std::string::npos);
    EXPECT_EQ(runVorelpaintInto("/dev/full", {"--print-key"}).exitCode, 2);
}

TEST_F(Program, OutputNamedLikeAnotherKindOfFile_IsRefused) {
    const std::string refusal =
        "is named like another kind of file; only PNG is written: end it with .png";
    for (const char* name : {"a.jpg", "a.JPG", "look.json"}) {
        const std::string path = mDir.file(name);
        expectFailure({"-o", path, "A"}, "--output: '" + path + "' " + refusal);
        expectFailure({"--sheet", "-o", path, "A"}, "--output: '" + path + "' " + refusal);
    }
    for (const char* name : {"a.PNG", "tmp.aBcD12", "plain"})
        EXPECT_EQ(runVorelpaint({"-o", mDir.file(name), "A"}).exitCode, 0) << name;
}

TEST_F(Program, FailureKeepsTheOlderPicture) {
    const std::string path = mDir.write("old.png", "older picture");
    expectFailure({"-o", path, "--font", "No Such Family", "A"}, "No Such Family");
    EXPECT_EQ(readBytes(path), "older picture");
}

}  // namespace
}  // namespace vorelpaint
