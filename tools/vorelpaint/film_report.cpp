#include "film_report.h"

#include <nlohmann/json.hpp>

#include "numbered_name.h"

namespace vorelpaint {
namespace {

using Json = nlohmann::ordered_json;

double seconds(int64_t ms) {
    return static_cast<double>(ms) / 1000;
}

Json cueJson(const PlacedCue& placed) {
    return {{"line", placed.cue.line},
            {"start", seconds(placed.cue.startMs)},
            {"end", seconds(placed.cue.endMs)},
            {"first-frame", placed.firstFrame},
            {"end-frame", placed.endFrame},
            {"box",
             {{"left", placed.box.left},
              {"top", placed.box.top},
              {"right", placed.box.right},
              {"bottom", placed.box.bottom}}},
            {"names", placed.cue.names},
            {"text", placed.cue.text}};
}

}  // namespace

std::string filmReport(const Options& options, const FilmCues& cues) {
    const bool hasPictures = options.output && options.film.pictureOf == PictureOf::cue;
    std::string report;
    int64_t number = 0;
    for (const PlacedCue& placed : cues.all()) {
        ++number;
        Json line;
        if (hasPictures) line["output"] = NumberedName::parse(*options.output)->with(number);
        line.update(cueJson(placed));
        // Names of files and cues may have any bytes.
        report += line.dump(-1, ' ', false, Json::error_handler_t::replace) + "\n";
    }
    return report;
}

}  // namespace vorelpaint
