#pragma once

#include <string>

namespace vorelpaint {

struct FontFile {
    std::string path;
    long faceIndex = 0;
};

/// The font that `request` names: a file, or a family as fontconfig writes it ("DejaVu Serif",
/// "DejaVu Sans:bold"). Throws ToolError when there is no such file or family.
FontFile findFont(const std::string& request);

}  // namespace vorelpaint
