#include "text/paragraphs.h"

#include <fribidi.h>

#include <new>

#include "text/error.h"
#include "text/scripts.h"
#include "unicode/lines.h"
#include "unicode/utf8.h"

namespace voreltext {
namespace {

Paragraph emptyParagraph(size_t number, size_t begin) {
    return {number, begin, {}, {}, {}, false};
}

/// Fills in the levels and the direction. FriBidi's own question for the direction looks into isolates
/// too.
void orderLetters(Paragraph& paragraph) {
    const std::vector<uint32_t>& codes = paragraph.codes;
    if (codes.empty()) return;
    const auto length = static_cast<FriBidiStrIndex>(codes.size());
    std::vector<FriBidiCharType> types(codes.size());
    std::vector<FriBidiBracketType> brackets(codes.size());
    paragraph.levels.resize(codes.size());
    fribidi_get_bidi_types(codes.data(), length, types.data());
    fribidi_get_bracket_types(codes.data(), length, types.data(), brackets.data());
    FriBidiParType direction = FRIBIDI_PAR_ON;
    const FriBidiLevel levels = fribidi_get_par_embedding_levels_ex(
        types.data(), brackets.data(), length, &direction, paragraph.levels.data());
    if (levels == 0) throw std::bad_alloc();
    paragraph.isRightToLeft = FRIBIDI_IS_RTL(direction) != 0;
}

}  // namespace

std::vector<Paragraph> splitParagraphs(const std::vector<uint32_t>& text) {
    std::vector<Paragraph> paragraphs{emptyParagraph(1, 0)};
    for (size_t at = 0; at < text.size(); ++at) {
        const uint32_t code = text[at];
        if (vorelunicode::endsLine(code)) {
            const bool isTwo = code == '\r' && at + 1 < text.size() && text[at + 1] == '\n';
            if (isTwo) ++at;
            paragraphs.push_back(emptyParagraph(paragraphs.size() + 1, at + 1));
        } else if (vorelunicode::isControl(code) && code != '\t') {
            throw TextError("the text has the control character " + vorelunicode::nameOf(code) + " in " +
                            vorelunicode::placeName(text, at));
        } else {
            paragraphs.back().codes.push_back(code == '\t' ? ' ' : code);
        }
    }
    for (Paragraph& paragraph : paragraphs) {
        paragraph.scripts = scriptsOf(paragraph.codes);
        orderLetters(paragraph);
    }
    return paragraphs;
}

}  // namespace voreltext
