#include "settings.h"

#include <gtest/gtest.h>

#include <regex>
#include <set>
#include <sstream>
#include <string>

#include "completion.h"
#include "error.h"
#include "help_text.h"
#include "manual.h"

namespace vorelpaint {
namespace {

std::string shortest(double number) {
    std::ostringstream text;
    text << number;
    return text.str();
}

TEST(Settings, Names_AreUniqueAndDescribed) {
    std::set<std::string> names;
    for (const Setting& setting : settings()) {
        EXPECT_TRUE(names.insert(setting.name).second) << setting.name;
        EXPECT_FALSE(setting.description.empty()) << setting.name;
        EXPECT_NE(setting.description.back(), '.') << setting.name;
        EXPECT_EQ(setting.value.empty(), setting.kind == Setting::Kind::flag) << setting.name;
    }
}

TEST(Settings, Initial_IsWhatAFreshRequestHolds) {
    for (const Setting& setting : settings()) {
        if (setting.initial.empty()) continue;
        Options options;
        if (setting.forget) setting.forget(options);
        setting.read(options, setting.initial);
        const Options fresh;
        EXPECT_EQ(options.fonts, fresh.fonts) << setting.name;
        EXPECT_EQ(options.size, fresh.size) << setting.name;
        EXPECT_EQ(options.align, fresh.align) << setting.name;
        EXPECT_EQ(options.effectScale, fresh.effectScale) << setting.name;
        EXPECT_EQ(options.background.kind, fresh.background.kind) << setting.name;
        EXPECT_EQ(options.canvas.padding, fresh.canvas.padding) << setting.name;
        EXPECT_EQ(options.canvas.margin, fresh.canvas.margin) << setting.name;
        EXPECT_EQ(options.canvas.anchor, fresh.canvas.anchor) << setting.name;
        EXPECT_EQ(options.png, fresh.png) << setting.name;
        EXPECT_EQ(options.fit, fresh.fit) << setting.name;
        EXPECT_EQ(options.box, fresh.box) << setting.name;
        EXPECT_EQ(options.lineHeight, fresh.lineHeight) << setting.name;
        EXPECT_EQ(options.letterSpacing, fresh.letterSpacing) << setting.name;
    }
}

TEST(Settings, Descriptions_NameTheRangeThatIsTaken) {
    size_t numbers = 0;
    for (const Setting& setting : settings()) {
        if (setting.kind != Setting::Kind::number) continue;
        ++numbers;
        std::smatch range;
        const std::regex form("([0-9.]+) to ([0-9.]+)");
        ASSERT_TRUE(std::regex_search(setting.description, range, form)) << setting.description;
        Options options;
        EXPECT_NO_THROW(setting.read(options, range[1])) << setting.name;
        EXPECT_NO_THROW(setting.read(options, range[2])) << setting.name;
        const bool isWhole = setting.value == "PX";
        const double beyond = isWhole ? 1 : 0.001;
        const std::string below = shortest(std::stod(range[1]) - beyond);
        const std::string above = shortest(std::stod(range[2]) + beyond);
        EXPECT_THROW(setting.read(options, below), ToolError) << setting.name << " " << below;
        EXPECT_THROW(setting.read(options, above), ToolError) << setting.name << " " << above;
    }
    EXPECT_EQ(numbers, 8U);
}

TEST(Settings, DescriptionsOfLists_NameTheirRanges) {
    const auto tells = [](const char* name, const char* range) {
        return settingNamed(name).description.find(range) != std::string::npos;
    };
    EXPECT_TRUE(tells("font", "up to 16 times"));
    EXPECT_TRUE(tells("sizes", "1 to 16 of 1 to 1000 pixels"));
    EXPECT_TRUE(tells("letter-spacing", "-200 to 200"));
}

TEST(Help, NamesTheLimits) {
    const std::string help = helpFooter();
    for (const char* limit : {"16384 pixels on a side", "33554432 in all", "4096 pixels on a side",
                              "65536 bytes", "131072", "262144"}) {
        EXPECT_NE(std::regex_replace(help, std::regex("\\s+"), " ").find(limit), std::string::npos)
            << limit;
    }
}

TEST(Settings, WordsOf_AreTheLiteralOnes) {
    EXPECT_EQ(wordsOf(settingNamed("align")),
              (std::vector<std::string>{"left", "center", "right", "start", "end"}));
    EXPECT_EQ(wordsOf(settingNamed("anchor")).size(), 9U);
    EXPECT_EQ(wordsOf(settingNamed("background")),
              (std::vector<std::string>{"transparent", "checkerboard"}));
    EXPECT_TRUE(wordsOf(settingNamed("size")).empty());
    EXPECT_TRUE(wordsOf(settingNamed("sheet")).empty());
}

TEST(Settings, Words_AreAllAccepted) {
    for (const Setting& setting : settings()) {
        for (const std::string& word : wordsOf(setting)) {
            Options options;
            EXPECT_NO_THROW(setting.read(options, word)) << setting.name << " " << word;
        }
    }
}

/// As the manual page spells a name.
std::string roffName(const Setting& setting) {
    if (setting.isPositional) return "\\fI" + setting.value + "\\fR";
    std::string name = "\\fB\\-\\-";
    for (const char c : setting.name)
        name += c == '-' ? std::string("\\-") : std::string(1, c);
    return name + "\\fR";
}

TEST(Manual, EverySetting_HasItsPlace) {
    const std::string page = manualPage();
    for (const Setting& setting : settings())
        EXPECT_NE(page.find(roffName(setting)), std::string::npos) << setting.name;
    for (const std::string& command : exampleCommands()) {
        const std::string words = command.substr(0, command.find('-'));
        EXPECT_NE(page.find("\n" + words), std::string::npos) << command;
    }
}

TEST(Completion, EveryOption_IsInEveryScript) {
    for (const char* shell : {"bash", "zsh", "fish"}) {
        const std::string script = completionScript(shell);
        for (const Setting& setting : settings()) {
            if (setting.isPositional) continue;
            const std::string name =
                std::string(shell) == "fish" ? "-l " + setting.name + " " : "--" + setting.name;
            EXPECT_NE(script.find(name), std::string::npos) << shell << " " << setting.name;
        }
    }
}

}  // namespace
}  // namespace vorelpaint
