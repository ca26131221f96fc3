#include "output_name.h"

#include <algorithm>
#include <array>
#include <filesystem>
#include <system_error>

#include "error.h"
#include "file_io.h"
#include "path_ending.h"
#include "style/vorelstyle.h"

namespace vorelpaint {
namespace {

namespace fs = std::filesystem;

/// Pictures, documents and films; and what the program itself reads and prints, which a forgotten value
/// would let it overwrite.
constexpr std::array<std::string_view, 60> kOtherKinds{
    "jpg",  "jpeg", "jpe",  "jfif",  "jp2", "jxl",  "gif", "webp", "avif", "heic", "heif", "bmp",
    "dib",  "ico",  "tif",  "tiff",  "tga", "ppm",  "pgm", "pbm",  "pnm",  "pam",  "qoi",  "dds",
    "exr",  "hdr",  "psd",  "xcf",   "svg", "svgz", "pdf", "ps",   "eps",  "apng", "mng",  "mp4",
    "webm", "html", "json", "jsonl", "txt", "cpp",  "ttf", "otf",  "ttc",  "otc",  "pfa",  "pfb",
    "pcf",  "bdf",  "woff", "woff2", "md",  "mov",  "mkv", "rgba", "srt",  "vtt",  "ass",  "ssa"};

/// The file itself that a path without a link at its end leads to; the path as far as that cannot be
/// told.
std::string resolved(const fs::path& path) {
    std::error_code error;
    const fs::path whole = fs::absolute(path, error);
    const fs::path file = fs::weakly_canonical(whole, error);
    return (error ? whole : file).lexically_normal().string();
}

/// Nothing where nothing can be written, of which who tries says why.
std::optional<fs::path> targetOf(const std::string& path) {
    try {
        return followLinks(path);
    } catch (const ToolError&) {
        return std::nullopt;
    }
}

/// Whether every job may write there: into a device, a pipe or an open file.
bool isForAll(const fs::path& path) {
    std::error_code ignored;
    return openFileOf(path) || (fs::exists(path, ignored) && !fs::is_regular_file(path, ignored));
}

}  // namespace

bool namesOtherKind(std::string_view path) {
    const std::string_view kind = endingOf(path);
    return std::any_of(kOtherKinds.begin(), kOtherKinds.end(),
                       [&](std::string_view other) { return vorelstyle::isSameWord(kind, other); });
}

bool isWritten(const std::string& path) {
    const std::optional<fs::path> target = targetOf(path);
    std::error_code error;
    if (!target || isForAll(*target)) return false;
    const uintmax_t size = fs::file_size(*target, error);
    return !error && size > 0;
}

std::optional<size_t> OutputNames::claim(const std::string& path, size_t line) {
    const std::optional<fs::path> target = targetOf(path);
    if (!target || isForAll(*target)) return std::nullopt;
    const auto [first, isNew] = mLines.try_emplace(resolved(*target), line);
    return isNew ? std::nullopt : std::optional<size_t>(first->second);
}

}  // namespace vorelpaint
