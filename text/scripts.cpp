#include "text/scripts.h"

#include <hb.h>

#include <cstddef>
#include <iterator>

namespace voreltext {
namespace {

/// Brackets and quotation marks, each opening one before its closing one.
constexpr uint32_t kPairs[]{0x28,   0x29,   0x3C,   0x3E,   0x5B,   0x5D,   0x7B,   0x7D,   0xAB,
                            0xBB,   0x2018, 0x2019, 0x201C, 0x201D, 0x2039, 0x203A, 0x3008, 0x3009,
                            0x300A, 0x300B, 0x300C, 0x300D, 0x300E, 0x300F, 0x3010, 0x3011, 0x3014,
                            0x3015, 0x3016, 0x3017, 0x3018, 0x3019, 0x301A, 0x301B};

/// The place among the pairs, their end for what is no bracket.
size_t pairOf(uint32_t code) {
    size_t place = 0;
    while (place < std::size(kPairs) && kPairs[place] != code)
        ++place;
    return place;
}

bool isOfSeveral(uint32_t script) {
    return script == HB_SCRIPT_COMMON || script == HB_SCRIPT_INHERITED;
}

/// Follows the brackets of a text.
class Brackets {
  public:
    /// The script of a character of several scripts behind one of `before`.
    uint32_t scriptOf(uint32_t code, uint32_t before) {
        const size_t place = pairOf(code);
        if (place == std::size(kPairs)) return before;
        if (place % 2 == 0) {
            mOpen.push_back({place, before});
            return before;
        }
        while (!mOpen.empty() && mOpen.back().place != place - 1)
            mOpen.pop_back();
        return mOpen.empty() ? before : mOpen.back().script;
    }

  private:
    struct Opening {
        size_t place;
        uint32_t script;
    };
    std::vector<Opening> mOpen;
};

}  // namespace

std::vector<uint32_t> scriptsOf(const std::vector<uint32_t>& codes) {
    hb_unicode_funcs_t* const unicode = hb_unicode_funcs_get_default();
    std::vector<uint32_t> scripts;
    scripts.reserve(codes.size());
    Brackets brackets;
    for (const uint32_t code : codes) {
        const uint32_t own = hb_unicode_script(unicode, code);
        const bool follows = isOfSeveral(own) && !scripts.empty();
        if (!follows) {
            scripts.push_back(own);
        } else if (own == HB_SCRIPT_COMMON) {
            scripts.push_back(brackets.scriptOf(code, scripts.back()));
        } else {
            scripts.push_back(scripts.back());
        }
    }
    for (size_t i = codes.size(); i-- > 1;) {
        if (isOfSeveral(scripts[i - 1])) scripts[i - 1] = scripts[i];
    }
    return scripts;
}

}  // namespace voreltext
