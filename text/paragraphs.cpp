#include "text/paragraphs.h"

#include <fribidi.h>

#include <string>

#include "text/error.h"
#include "unicode/characters.h"
#include "unicode/utf8.h"

namespace voreltext {
namespace {

[[noreturn]] void refuseControl(uint32_t code, size_t line, size_t character) {
    throw TextError("the text has the control character " + vorelunicode::nameOf(code) + " in line " +
                    std::to_string(line) + ", character " + std::to_string(character));
}

}  // namespace

std::vector<Paragraph> splitParagraphs(const std::vector<uint32_t>& text) {
    std::vector<Paragraph> paragraphs{{1, 0, {}}};
    for (size_t at = 0; at < text.size(); ++at) {
        const uint32_t code = text[at];
        std::vector<uint32_t>& codes = paragraphs.back().codes;
        if (vorelunicode::isLineEnd(code)) {
            const bool isTwo = code == '\r' && at + 1 < text.size() && text[at + 1] == '\n';
            if (isTwo) ++at;
            paragraphs.push_back({paragraphs.size() + 1, at + 1, {}});
        } else if (vorelunicode::isControl(code) && code != '\t') {
            refuseControl(code, paragraphs.back().number, codes.size() + 1);
        } else {
            codes.push_back(code == '\t' ? ' ' : code);
        }
    }
    return paragraphs;
}

bool isRightToLeft(const Paragraph& paragraph) {
    const auto length = static_cast<FriBidiStrIndex>(paragraph.codes.size());
    std::vector<FriBidiCharType> types(paragraph.codes.size());
    fribidi_get_bidi_types(paragraph.codes.data(), length, types.data());
    return fribidi_get_par_direction(types.data(), length) == FRIBIDI_PAR_RTL;
}

}  // namespace voreltext
