#include "batch_job.h"

#include <gtest/gtest.h>

#include <string>
#include <variant>

#include "error.h"

namespace vorelpaint {
namespace {

const Options kCommon;

Options jobOf(const std::string& members, const Options& common = kCommon) {
    return parseJob(R"({"text": "A", "output": "a.png")" + (members.empty() ? "" : ", " + members) + "}",
                    common);
}

std::string faultOf(const std::string& line) {
    try {
        parseJob(line, kCommon);
        return "";
    } catch (const std::runtime_error& error) {
        return error.what();
    }
}

std::string faultOfMember(const std::string& member) {
    return faultOf(R"({"text": "A", "output": "a.png", )" + member + "}");
}

TEST(BatchJob, EachKey_IsRead) {
    const Options job = jobOf(
        R"("font": "DejaVu Serif", "size": 12, "align": "right", "preset": "gold", "effect-scale": 2.5,
           "color": "#010203", "opacity": 0.25, "background": "checkerboard", "padding": 0)");
    EXPECT_EQ(job.text, "A");
    EXPECT_EQ(job.output, "a.png");
    EXPECT_EQ(job.fonts, std::vector<std::string>{"DejaVu Serif"});
    EXPECT_EQ(job.size, 12);
    EXPECT_EQ(job.align, voreltext::Align::right);
    EXPECT_EQ(job.preset, "gold");
    EXPECT_EQ(job.effectScale, 2.5F);
    EXPECT_EQ(job.color, 0x010203U);
    EXPECT_EQ(job.opacity, 0.25F);
    EXPECT_EQ(job.background.kind, Background::Kind::checkerboard);
    EXPECT_EQ(job.canvas.padding, 0);
}

TEST(BatchJob, KeysOfTextAndCanvas_AreRead) {
    const Options job = jobOf(
        R"("font": ["DejaVu Sans", "DejaVu Serif"], "font-features": "liga=0,ss01",
           "font-variations": "wght=700,wdth=80.5", "markup": true, "line-height": 1.5,
           "letter-spacing": "2.5%", "width": 640, "height": 360, "anchor": "bottom-left",
           "margin": 20, "fit": "wrap", "box": "line", "align": "end")");
    EXPECT_EQ(job.fonts, (std::vector<std::string>{"DejaVu Sans", "DejaVu Serif"}));
    EXPECT_EQ(job.features, (std::vector<std::string>{"liga=0", "ss01"}));
    ASSERT_EQ(job.variations.size(), 2U);
    EXPECT_EQ(job.variations[1].axis, "wdth");
    EXPECT_EQ(job.variations[1].value, 80.5F);
    EXPECT_TRUE(job.markup);
    EXPECT_EQ(job.lineHeight, 1.5F);
    EXPECT_EQ(job.letterSpacing, (vorelstyle::Length{2.5F, vorelstyle::Length::Unit::percent}));
    EXPECT_EQ(job.canvas.width, 640);
    EXPECT_EQ(job.canvas.height, 360);
    EXPECT_EQ(job.canvas.anchor, voreltext::Anchor::bottomLeft);
    EXPECT_EQ(job.canvas.margin, 20);
    EXPECT_EQ(job.fit, Fit::wrap);
    EXPECT_EQ(job.box, TextBox::line);
    EXPECT_EQ(job.align, voreltext::Align::end);
}

TEST(BatchJob, LetterSpacing_IsANumberOrALength) {
    EXPECT_EQ(jobOf(R"("letter-spacing": -3)").letterSpacing, (vorelstyle::Length{-3}));
    EXPECT_EQ(jobOf(R"("letter-spacing": "4px")").letterSpacing, (vorelstyle::Length{4}));
    EXPECT_EQ(faultOfMember(R"("letter-spacing": true)"),
              "letter-spacing: must be a string, not a boolean");
    EXPECT_EQ(faultOfMember(R"("letter-spacing": "4em")"),
              "letter-spacing: '4em' is no length from -200 to 200 in pixels or, with a %, in percent");
}

TEST(BatchJob, FontsOfAJob_TakeThePlaceOfTheCommon) {
    Options common;
    common.fonts = {"A", "B"};
    EXPECT_EQ(parseJob(R"({"text": "x", "output": "a.png", "font": "C"})", common).fonts,
              std::vector<std::string>{"C"});
    EXPECT_EQ(parseJob(R"({"text": "x", "output": "a.png"})", common).fonts,
              (std::vector<std::string>{"A", "B"}));
    EXPECT_EQ(faultOfMember(R"("font": [])"), "font: has 0 elements, 1 to 16 are allowed");
    EXPECT_EQ(faultOfMember(R"("font": ["A", 1])"), "font[1]: must be a string, not a number");
    EXPECT_EQ(faultOfMember(R"("font": ["-"])"),
              "font: must name a file: jobs have no standard input or output");
}

TEST(BatchJob, Flags_AreTrueOrFalse) {
    Options common;
    common.markup = true;
    EXPECT_FALSE(parseJob(R"({"text": "x", "output": "a.png", "markup": false})", common).markup);
    EXPECT_EQ(faultOfMember(R"("markup": 1)"), "markup: must be true or false, not a number");
}

TEST(BatchJob, FitWithoutASide_IsRefused) {
    EXPECT_EQ(faultOfMember(R"("fit": "wrap", "height": 9)"),
              "fit: wrap breaks lines at a width; none is given");
    EXPECT_EQ(faultOfMember(R"("fit": "shrink")"),
              "fit: shrink makes a text fit a width or a height; neither is given");
}

TEST(BatchJob, Numbers_AreReadAsTheCommandLineReadsThem) {
    EXPECT_EQ(jobOf(R"("opacity": 1e-1)").opacity, 0.1F);
    EXPECT_EQ(jobOf(R"("effect-scale": 0.7)").effectScale, 0.7F);
    EXPECT_EQ(jobOf(R"("size": 96.0)").size, 96);
    EXPECT_EQ(jobOf(R"("width": 1e3)").canvas.width, 1000);
}

TEST(BatchJob, Style_IsAFileOrAnObject) {
    EXPECT_EQ(jobOf(R"("style": "look.json")").style, "look.json");
    const Options job = jobOf(R"("style": {"outerGlow": {"size": 3, "color": "#0000FF"}})");
    ASSERT_TRUE(job.inlineStyle);
    ASSERT_EQ(job.inlineStyle->looks[0].effects.size(), 1U);
    EXPECT_EQ(std::get<vorelstyle::OuterGlow>(job.inlineStyle->looks[0].effects[0]).size.value, 3.0F);
}

TEST(BatchJob, WhatAJobDoesNotSay_IsTheCommandLines) {
    Options common;
    common.size = 33;
    common.preset = "gold";
    common.text = "common";
    const Options job = parseJob(R"({"output": "a.png"})", common);
    EXPECT_EQ(job.size, 33);
    EXPECT_EQ(job.preset, "gold");
    EXPECT_EQ(job.text, "common");
}

TEST(BatchJob, WhatAJobSays_ReplacesTheOtherOfThePair) {
    Options common;
    common.preset = "gold";
    common.textFile = "words.txt";
    const Options job = jobOf(R"("style": {})", common);
    EXPECT_FALSE(job.preset);
    EXPECT_FALSE(job.textFile);
    EXPECT_EQ(job.text, "A");
    EXPECT_FALSE(jobOf(R"("preset": "neon")", common).style);
}

TEST(BatchJob, UnknownKeys_AreRefusedWithTheKnownOnes) {
    EXPECT_EQ(
        faultOfMember(R"("colour": "#000000")"),
        "colour: unknown key; did you mean color? Known are text, text-file, markup, align, "
        "line-height, "
        "letter-spacing, font, size, font-features, font-variations, style, preset, effect-scale, "
        "color, opacity, width, height, anchor, margin, fit, box, padding, output, background, png");
    EXPECT_EQ(faultOfMember(R"("batch": "b.jsonl")").rfind("batch: unknown key", 0), 0U);
    EXPECT_EQ(faultOfMember(R"("help": true)").rfind("help: unknown key", 0), 0U);
}

TEST(BatchJob, WrongTypes_AreNamed) {
    EXPECT_EQ(faultOf("[]"), "must be an object, not an array");
    EXPECT_EQ(faultOfMember(R"("size": "12")"), "size: must be a number, not a string");
    EXPECT_EQ(faultOfMember(R"("align": 1)"), "align: must be a string, not a number");
    EXPECT_EQ(faultOfMember(R"("style": 1)"), "style: must be a string, not a number");
    EXPECT_EQ(faultOf(R"({"text": null, "output": "a.png"})"), "text: must be a string, not null");
}

TEST(BatchJob, WrongValues_AreNamedWithTheirRange) {
    EXPECT_EQ(faultOfMember(R"("size": 0)"), "size: '0' is no whole number from 1 to 1000");
    EXPECT_EQ(faultOfMember(R"("size": 12.5)"), "size: '12.5' is no whole number from 1 to 1000");
    EXPECT_EQ(faultOfMember(R"("align": "middle")"),
              "align: 'middle' is none of left, center, right, start, end");
    EXPECT_EQ(faultOfMember(R"("color": "red")"), "color: 'red' is no colour; write #RRGGBB or #RGB");
}

TEST(BatchJob, FaultsOfAnInlineStyle_HaveTheirPath) {
    EXPECT_EQ(faultOfMember(R"("style": {"stroke": {"size": 200}})"),
              "style.stroke.size: 200 is out of range, 0 to 100");
    EXPECT_EQ(faultOfMember(R"("style": {"stroke": {"size": 1, "size": 2}})"),
              "style.stroke.size: key given twice");
    EXPECT_EQ(faultOfMember(R"("style": {"glow": {}})").rfind("style.glow: unknown key", 0), 0U);
}

TEST(BatchJob, Pairs_AreRefused) {
    EXPECT_EQ(faultOfMember(R"("text-file": "t")"), "text-file: stands beside text");
    EXPECT_EQ(faultOfMember(R"("style": {}, "preset": "gold")"), "preset: stands beside style");
}

TEST(BatchJob, MissingOutputOrText_IsNamed) {
    EXPECT_EQ(faultOf(R"({"text": "A"})"), "output: missing; the PNG file to write");
    EXPECT_EQ(faultOf(R"({"output": "a.png"})"), "text: missing; a job has text or text-file");
}

TEST(BatchJob, StandardInputAndOutput_AreNotForJobs) {
    const std::string refusal = "must name a file: jobs have no standard input or output";
    EXPECT_EQ(faultOf(R"({"text": "A", "output": "-"})"), "output: " + refusal);
    EXPECT_EQ(faultOf(R"({"text-file": "-", "output": "a.png"})"), "text-file: " + refusal);
    EXPECT_EQ(faultOfMember(R"("style": "-")"), "style: " + refusal);
    EXPECT_EQ(parseJob(R"({"text": "-", "output": "a.png"})", kCommon).text, "-");
}

TEST(BatchJob, NulInAName_IsRefused) {
    EXPECT_EQ(faultOf(R"({"text": "A", "output": "a.png\u0000.txt"})"), "output: has a NUL character");
}

TEST(BatchJob, SyntaxErrors_NameTheColumn) {
    EXPECT_EQ(faultOf(R"({"text": })").rfind("no valid JSON: column 10: ", 0), 0U)
        << faultOf(R"({"text": })");
    EXPECT_EQ(faultOf(R"({"text": "A"} {})").rfind("no valid JSON: column 15: ", 0), 0U)
        << faultOf(R"({"text": "A"} {})");
    EXPECT_EQ(faultOf(R"({"text": "A", "text": "B"})"), "text: key given twice");
}

TEST(BatchJob, OverlongLine_IsRefused) {
    EXPECT_EQ(faultOf(std::string((1 << 18) + 1, ' ')), "longer than 262144 bytes");
}

}  // namespace
}  // namespace vorelpaint
