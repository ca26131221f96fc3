#include "text/utf8.h"

#include <cstddef>
#include <string>

#include "text/error.h"
#include "unicode/utf8.h"

namespace voreltext {
namespace {

[[noreturn]] void fail(size_t at) {
    throw TextError("the text is not valid UTF-8 at byte " + std::to_string(at + 1));
}

}  // namespace

std::vector<uint32_t> decodeUtf8(std::string_view text) {
    std::vector<uint32_t> codes;
    codes.reserve(text.size());
    for (size_t at = 0; at < text.size();) {
        const auto [code, length] = vorelunicode::decodeAt(text, at);
        if (length == 0) fail(at);
        codes.push_back(code);
        at += length;
    }
    return codes;
}

}  // namespace voreltext
