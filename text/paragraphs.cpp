#include "text/paragraphs.h"

#include <fribidi.h>

#include <new>

#include "text/error.h"
#include "unicode/lines.h"
#include "unicode/utf8.h"

namespace voreltext {
namespace {

/// FriBidi tells it along with the levels alone: its question for the direction looks into isolates too.
bool isRightToLeft(const std::vector<uint32_t>& codes) {
    if (codes.empty()) return false;
    const auto length = static_cast<FriBidiStrIndex>(codes.size());
    std::vector<FriBidiCharType> types(codes.size());
    std::vector<FriBidiBracketType> brackets(codes.size());
    std::vector<FriBidiLevel> levels(codes.size());
    fribidi_get_bidi_types(codes.data(), length, types.data());
    fribidi_get_bracket_types(codes.data(), length, types.data(), brackets.data());
    FriBidiParType direction = FRIBIDI_PAR_ON;
    const FriBidiLevel levelsFound = fribidi_get_par_embedding_levels_ex(
        types.data(), brackets.data(), length, &direction, levels.data());
    if (levelsFound == 0) throw std::bad_alloc();
    return FRIBIDI_IS_RTL(direction) != 0;
}

}  // namespace

std::vector<Paragraph> splitParagraphs(const std::vector<uint32_t>& text) {
    std::vector<Paragraph> paragraphs{{1, 0, {}, false}};
    for (size_t at = 0; at < text.size(); ++at) {
        const uint32_t code = text[at];
        std::vector<uint32_t>& codes = paragraphs.back().codes;
        if (vorelunicode::endsLine(code)) {
            const bool isTwo = code == '\r' && at + 1 < text.size() && text[at + 1] == '\n';
            if (isTwo) ++at;
            paragraphs.push_back({paragraphs.size() + 1, at + 1, {}, false});
        } else if (vorelunicode::isControl(code) && code != '\t') {
            throw TextError("the text has the control character " + vorelunicode::nameOf(code) + " in " +
                            vorelunicode::placeName(text, at));
        } else {
            codes.push_back(code == '\t' ? ' ' : code);
        }
    }
    for (Paragraph& paragraph : paragraphs)
        paragraph.isRightToLeft = isRightToLeft(paragraph.codes);
    return paragraphs;
}

}  // namespace voreltext
