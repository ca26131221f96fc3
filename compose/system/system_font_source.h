#pragma once

#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <vector>

#include "compose/font_source.h"
#include "compose/shelf.h"
#include "text/voreltext.h"

namespace vorelcompose {

/// Fonts of files, and those that are installed, which fontconfig knows. For several threads at a time.
class SystemFontSource : public FontSource {
  public:
    /// Reads what fontconfig knows.
    using Load = std::function<std::unique_ptr<voreltext::SystemFonts>()>;

    /// `load` is called when a family is asked for that is not, the first time, and before that by
    /// load().
    explicit SystemFontSource(Load load = std::make_unique<voreltext::SystemFonts>);

    /// Reads what fontconfig knows, unless it has been read.
    void load();

    /// A request names a file, or a family as fontconfig writes it ("DejaVu Serif", "DejaVu
    /// Sans:bold"). What has a slash names a file, be it there or not. Throws ComposeError when there is
    /// no such file, TextError when there is no such family.
    Found find(const std::string& request) override;

    voreltext::Font open(const voreltext::FontFile& file, int size,
                         const std::vector<voreltext::FontVariation>& variations) override;

    /// An installed font.
    std::optional<voreltext::FontFile> fallback(const voreltext::Cluster& cluster,
                                                const voreltext::FontFile& main) override;

  private:
    static constexpr size_t kMostNames = 64;

    voreltext::FontFile findInstalled(const std::string& request);
    voreltext::SystemFonts& installed();

    Load mLoad;
    std::mutex mMutex;  ///< of what follows; fontconfig is for one thread
    std::unique_ptr<voreltext::SystemFonts> mInstalled;
    Shelf<std::string, voreltext::FontFile> mNamed{
        kMostNames};  ///< fontconfig takes a while to find one
};

}  // namespace vorelcompose
