#include "report.h"

#include <algorithm>
#include <nlohmann/json.hpp>
#include <string>
#include <vector>

#include "unicode/utf8.h"

namespace vorelpaint {
namespace {

using Json = nlohmann::ordered_json;
using voreltext::Box;
using voreltext::Canvas;
using voreltext::Line;
using voreltext::Margins;
using voreltext::MissingCharacter;

Json boxJson(const Box& box, const Canvas& canvas) {
    return {{"left", box.left + canvas.x},
            {"top", box.top + canvas.y},
            {"right", box.right + canvas.x},
            {"bottom", box.bottom + canvas.y}};
}

Json marginsJson(const Margins& margins) {
    return {{"left", margins.left},
            {"top", margins.top},
            {"right", margins.right},
            {"bottom", margins.bottom}};
}

std::string utf8Of(const std::vector<uint32_t>& text, size_t begin, size_t end) {
    std::string bytes;
    for (size_t i = begin; i < end; ++i)
        bytes += vorelunicode::encoded(text[i]);
    return bytes;
}

Json lineJson(const Line& line, const std::vector<uint32_t>& text, const Canvas& canvas) {
    return {{"text", utf8Of(text, line.begin, line.end)},
            {"direction", line.isRightToLeft ? "right-to-left" : "left-to-right"},
            {"baseline", line.baseline + canvas.y},
            {"box", boxJson(line.box, canvas)},
            {"ink", boxJson(line.ink, canvas)}};
}

Json missingJson(const MissingCharacter& missing, const SourceText& source) {
    return {{"code", vorelunicode::nameOf(missing.code)},
            {"text", vorelunicode::encoded(missing.code)},
            {"count", missing.count},
            {"first", source.placeName(missing.first)}};
}

}  // namespace

std::string reportOf(const Options& options, const Composition& composition) {
    const Canvas& canvas = composition.canvas();
    const voreltext::TextLayout& layout = composition.text().layout();
    Json report;
    if (options.output) report["output"] = *options.output;
    report["width"] = canvas.width;
    report["height"] = canvas.height;
    report["size"] = composition.text().size();
    report["baseline"] = layout.lines().front().baseline + canvas.y;
    report["ink"] = boxJson(layout.inkBox(), canvas);
    report["box"] = boxJson(composition.text().box(), canvas);
    report["margins"] = marginsJson(composition.margins());
    report["lines"] = Json::array();
    for (const Line& line : layout.lines())
        report["lines"].push_back(lineJson(line, composition.source().text(), canvas));
    report["key"] = vorelstyle::hexadecimal(composition.looks().stack().key());
    report["fonts"] = layout.fontsUsed();
    report["missing"] = Json::array();
    for (const MissingCharacter& missing : layout.missing())
        report["missing"].push_back(missingJson(missing, composition.source()));
    // Names of files and fonts may have any bytes.
    return report.dump(-1, ' ', false, Json::error_handler_t::replace);
}

}  // namespace vorelpaint
