#pragma once

#include <cstdint>
#include <fstream>
#include <iterator>
#include <optional>
#include <string>
#include <vector>

#include "compose/error.h"
#include "compose/font_source.h"

namespace vorelcompose {

/// A font that is brought along as bytes, under the name "mine".
class FontOfBytes : public FontSource {
  public:
    FontOfBytes() {
        std::ifstream file(VOREL_TEST_FONT, std::ios::binary);
        mBytes.assign(std::istreambuf_iterator<char>(file), {});
    }
    Found find(const std::string& request) override {
        if (request != "mine") throw ComposeError("no font '" + request + "'");
        return {{request, 0}, {}};
    }
    voreltext::Font open(const voreltext::FontFile& /*file*/, int size,
                         const std::vector<voreltext::FontVariation>& variations) override {
        ++opened;
        return {voreltext::FontBytes{mBytes.data(), mBytes.size()}, size, variations};
    }
    std::optional<voreltext::FontFile> fallback(const voreltext::Cluster& /*cluster*/,
                                                const voreltext::FontFile& /*main*/) override {
        return std::nullopt;
    }

    int opened = 0;

  private:
    std::vector<uint8_t> mBytes;
};

}  // namespace vorelcompose
