#pragma once

#include <string>
#include <string_view>
#include <vector>

/// The plain text of a cue as each format marks it up. Blank lines at its ends are dropped.
namespace vorelpaint {

/// The tags of SubRip files (<i>, <font color=...>, ...) and what stands in {\...} are dropped, <br> is
/// a line break and character references are decoded; any other < or & stands for itself.
std::string textOfSrt(std::string_view written);

struct VttText {
    std::string text;
    std::vector<std::string> names;  ///< classes and voices, in the order of the text
};

/// All tags are dropped, and character references are decoded.
VttText textOfVtt(std::string_view written);

/// What stands in {...} is dropped, and so are the drawings that such blocks begin and end (\p1, \p0).
/// \N is a line break, \n a blank and \h a no-break space.
std::string textOfAss(std::string_view written);

}  // namespace vorelpaint
