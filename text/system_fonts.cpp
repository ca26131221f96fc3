#include "text/system_fonts.h"

#include <algorithm>
#include <array>
#include <map>
#include <new>
#include <sstream>
#include <string>
#include <string_view>
#include <vector>

#include "text/error.h"
#include "text/font_coverage.h"
#include "text/fontconfig.h"
#include "unicode/nearest.h"

namespace voreltext {
namespace {

/// Names that stand for whatever family the system prefers.
constexpr std::array<std::string_view, 4> kGenericFamilies{"sans-serif", "sans", "serif", "monospace"};

bool areSame(std::string_view one, std::string_view other) {
    return FcStrCmpIgnoreCase(fcText(std::string(one)), fcText(std::string(other))) == 0;
}

bool isGeneric(std::string_view family) {
    return std::any_of(kGenericFamilies.begin(), kGenericFamilies.end(),
                       [&](std::string_view generic) { return areSame(family, generic); });
}

/// fontconfig answers every request with its nearest font; only one of the family asked for counts.
bool hasFamily(const FcPattern* font, const FcChar8* family) {
    if (isGeneric(reinterpret_cast<const char*>(family))) return true;
    FcChar8* name = nullptr;
    for (int i = 0; FcPatternGetString(font, FC_FAMILY, i, &name) == FcResultMatch; ++i) {
        if (FcStrCmpIgnoreCase(name, family) == 0) return true;
    }
    return false;
}

/// What the refusal of a misspelt name ends with.
std::string suggestion(const std::string& name) {
    return name.empty() ? "" : "; did you mean '" + name + "'?";
}

[[noreturn]] void fail(const std::string& request, const std::string& fault) {
    throw TextError("font '" + request + "': " + fault);
}

/// The parts of a request: the family, and what stands behind each ':'. A backslash takes a character as
/// it is.
std::vector<std::string> partsOf(const std::string& request) {
    std::vector<std::string> parts(1);
    for (size_t at = 0; at < request.size(); ++at) {
        if (request[at] == ':') {
            parts.emplace_back();
            continue;
        }
        parts.back() += request[at];
        if (request[at] == '\\' && at + 1 < request.size()) parts.back() += request[++at];
    }
    return parts;
}

/// The place of a '-' that is none of the name's own, for fontconfig the begin of a size.
size_t sizeIn(const std::string& family) {
    for (size_t at = 0; at < family.size(); ++at) {
        if (family[at] == '\\') {
            ++at;
        } else if (family[at] == '-') {
            return at;
        }
    }
    return std::string::npos;
}

/// Whether fontconfig knows a style, "bold", or a property, "weight=200".
bool isKnown(const std::string& property) {
    const FontPattern parsed(FcNameParse(fcText(":" + property)));
    if (!parsed || FcPatternObjectCount(parsed.get()) == 0) return false;
    const size_t equals = property.find('=');
    if (equals == std::string::npos) return true;
    const FcObjectType* type = FcNameGetObjectType(property.substr(0, equals).c_str());
    return type != nullptr && type->type != FcTypeUnknown;
}

/// The words that fontconfig knows for weights, widths and slants.
constexpr std::array<std::string_view, 27> kStyles{
    "thin",      "extralight",     "ultralight",     "demilight", "semilight",     "light",
    "book",      "regular",        "medium",         "demibold",  "semibold",      "bold",
    "extrabold", "ultrabold",      "black",          "heavy",     "roman",         "italic",
    "oblique",   "ultracondensed", "extracondensed", "condensed", "semicondensed", "semiexpanded",
    "expanded",  "extraexpanded",  "ultraexpanded"};
constexpr std::array<std::string_view, 8> kProperties{"style", "weight",  "width",    "slant",
                                                      "lang",  "spacing", "variable", "color"};

/// The style or property that is meant by a misspelt one, "bold" or "weight=200"; empty without.
std::string nearestProperty(const std::string& property) {
    const size_t equals = property.find('=');
    if (equals == std::string::npos) return vorelunicode::nearest(property, kStyles);
    const std::string name = vorelunicode::nearest(property.substr(0, equals), kProperties);
    const std::string value = property.substr(equals + 1);
    const std::string style = vorelunicode::nearest(value, kStyles);
    const std::string meant = name + "=" + (style.empty() ? value : style);
    return !name.empty() && isKnown(meant) ? meant : "";
}

/// fontconfig reads past what it does not know, and a regular font would stand for a misspelt bold.
void refuseWhatIsNotKnown(const std::string& request, const std::vector<std::string>& parts) {
    if (sizeIn(parts.front()) != std::string::npos && !isGeneric(parts.front())) {
        throw TextError("no font file or family '" + request +
                        "'; a style stands behind a colon, as in 'DejaVu Sans:bold', and a name's own "
                        "dash behind a backslash");
    }
    for (size_t i = 1; i < parts.size(); ++i) {
        if (!parts[i].empty() && !isKnown(parts[i])) {
            fail(request, "'" + parts[i] + "' is no style and no property of fonts" +
                              suggestion(nearestProperty(parts[i])));
        }
    }
}

/// The bits above these tell the instances of a variable font apart.
constexpr int kFaceBits = 0xFFFF;

bool isSameFace(const FcPattern* one, const FcPattern* other) {
    FcChar8* oneFile = nullptr;
    FcChar8* otherFile = nullptr;
    int oneIndex = 0;
    int otherIndex = 0;
    FcPatternGetInteger(one, FC_INDEX, 0, &oneIndex);
    FcPatternGetInteger(other, FC_INDEX, 0, &otherIndex);
    return FcPatternGetString(one, FC_FILE, 0, &oneFile) == FcResultMatch &&
           FcPatternGetString(other, FC_FILE, 0, &otherFile) == FcResultMatch &&
           FcStrCmp(oneFile, otherFile) == 0 && (oneIndex & kFaceBits) == (otherIndex & kFaceBits);
}

/// Whether `font` is among the installed ones that have all that is asked for.
bool isListed(FcConfig* config, FcPattern* wanted, const FcPattern* font) {
    const Objects objects(FcObjectSetBuild(FC_FILE, FC_INDEX, nullptr));
    const FontList listed(FcFontList(config, wanted, objects.get()));
    if (!listed) return false;
    return std::any_of(listed->fonts, listed->fonts + listed->nfont,
                       [&](const FcPattern* each) { return isSameFace(each, font); });
}

/// Whether a font's name of its style has this word: "Condensed Bold" has "bold". In "Semi Bold" the
/// word says something else.
bool isNamed(const FcPattern* font, const std::string& word) {
    constexpr std::array<std::string_view, 4> kDegrees{"semi", "demi", "extra", "ultra"};
    FcChar8* style = nullptr;
    for (int i = 0; FcPatternGetString(font, FC_STYLE, i, &style) == FcResultMatch; ++i) {
        std::istringstream words(reinterpret_cast<const char*>(style));
        bool isFull = true;
        for (std::string each; words >> each;) {
            if (isFull && areSame(each, word)) return true;
            isFull = std::none_of(kDegrees.begin(), kDegrees.end(),
                                  [&](std::string_view degree) { return areSame(each, degree); });
        }
    }
    return false;
}

/// Takes out of a request, whose properties are `properties`, what a font's own name of its style says.
/// Many a face that is named "Book" is regular by its numbers, and "Condensed" semi-condensed:
/// fontconfig means other numbers by these words.
void dropWhatIsNamed(FcPattern* exact, const std::vector<std::string>& properties,
                     const FcPattern* font) {
    std::map<std::string, bool> isEachNamed;
    for (const std::string& word : properties) {
        const size_t equals = word.find('=');
        if (equals != std::string::npos) isEachNamed[word.substr(0, equals)] = false;
        const FcConstant* const constant = FcNameGetConstant(fcText(word));
        if (constant == nullptr) continue;
        const auto [object, isNew] = isEachNamed.try_emplace(constant->object, true);
        object->second = object->second && isNamed(font, word);
    }
    for (const auto& [object, isDropped] : isEachNamed) {
        if (isDropped) FcPatternDel(exact, object.c_str());
    }
}

/// Whether a font that was found for `wanted` has its style and its other `properties`. Few families
/// have both an italic and an oblique face: each stands for the other.
bool hasProperties(FcConfig* config, const FcPattern* wanted, const std::vector<std::string>& properties,
                   const FcPattern* font) {
    const FontPattern exact(FcPatternDuplicate(wanted));
    FcChar8* family = nullptr;
    if (!exact || FcPatternGetString(font, FC_FAMILY, 0, &family) != FcResultMatch) return false;
    FcPatternDel(exact.get(), FC_FAMILY);  // a generic one is no font's own
    FcPatternAddString(exact.get(), FC_FAMILY, family);
    dropWhatIsNamed(exact.get(), properties, font);
    if (isListed(config, exact.get(), font)) return true;
    int slant = FC_SLANT_ROMAN;
    FcPatternGetInteger(exact.get(), FC_SLANT, 0, &slant);
    if (slant == FC_SLANT_ROMAN) return false;
    FcPatternDel(exact.get(), FC_SLANT);
    FcPatternAddInteger(exact.get(), FC_SLANT,
                        slant == FC_SLANT_ITALIC ? FC_SLANT_OBLIQUE : FC_SLANT_ITALIC);
    return isListed(config, exact.get(), font);
}

/// The installed family that is meant by a misspelt one; empty without.
std::string nearestFamily(FcConfig* config, const std::string& family) {
    const FontPattern any(FcPatternCreate());
    const Objects objects(FcObjectSetBuild(FC_FAMILY, nullptr));
    const FontList listed(FcFontList(config, any.get(), objects.get()));
    std::vector<std::string> families;
    for (int i = 0; listed && i < listed->nfont; ++i)
        families.push_back(textOf(listed->fonts[i], FC_FAMILY));
    std::sort(families.begin(), families.end());
    return vorelunicode::nearest(family, families);
}

}  // namespace

struct SystemFonts::Config {
    FontConfig fonts{FcInitLoadConfigAndFonts()};
    FontCoverage coverage{fonts.get()};
};

SystemFonts::SystemFonts() : mConfig(new Config) {}

SystemFonts::~SystemFonts() = default;

FontFile SystemFonts::find(const std::string& request) const {
    const std::vector<std::string> parts = partsOf(request);
    refuseWhatIsNotKnown(request, parts);
    FcConfig* const config = mConfig->fonts.get();
    const FontPattern wanted(FcNameParse(fcText(request)));
    const std::string family = wanted ? textOf(wanted.get(), FC_FAMILY) : "";
    const auto refuse = [&]() {
        throw TextError("no font file or family '" + request + "'" +
                        suggestion(nearestFamily(config, family)));
    };
    if (config == nullptr || family.empty()) refuse();

    const FontPattern completed(FcPatternDuplicate(wanted.get()));
    if (!completed) throw std::bad_alloc();
    complete(config, completed.get());
    FcResult result = FcResultNoMatch;
    const FontPattern font(FcFontMatch(config, completed.get(), &result));
    if (!font || !hasFamily(font.get(), fcText(family))) refuse();
    if (!hasProperties(config, wanted.get(), {parts.begin() + 1, parts.end()}, font.get())) {
        fail(request, "the family is there, but no face of it is as asked for");
    }
    FontFile file = fileOf(font.get());
    if (file.path.empty()) refuse();
    return file;
}

std::optional<FontFile> SystemFonts::findFor(const Cluster& cluster, const FontFile& like) const {
    return mConfig->coverage.find(cluster, like);
}

}  // namespace voreltext
