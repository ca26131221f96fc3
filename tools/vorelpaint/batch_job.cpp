#include "batch_job.h"

#include <string_view>
#include <vector>

#include "error.h"
#include "ranges.h"
#include "settings.h"
#include "style/vorelstyle.h"

namespace vorelpaint {
namespace {

using vorelstyle::JsonDocument;
using vorelstyle::JsonObject;
using vorelstyle::JsonValue;
using vorelstyle::Style;
using vorelstyle::StyleError;

/// A job is one line, so what a syntax error says of lines is left out.
JsonDocument parseLine(const std::string& line) {
    if (line.size() > kMaxJobBytes) {
        throw ToolError("longer than " + std::to_string(kMaxJobBytes) + " bytes");
    }
    try {
        return JsonDocument(line);
    } catch (const StyleError& error) {
        constexpr std::string_view kPlace = "line 1, ";
        std::string fault = error.what();
        const size_t place = fault.find(kPlace);
        if (place != std::string::npos) fault.erase(place, kPlace.size());
        throw ToolError(fault);
    }
}

std::vector<std::string_view> jobKeys() {
    std::vector<std::string_view> keys;
    for (const Setting& setting : settings()) {
        if (setting.inJobs) keys.emplace_back(setting.name);
    }
    return keys;
}

/// Of two keys that exclude each other, the one of the job takes the place of the other of the command
/// line.
bool hasEither(const JsonObject& job, const char* one, const char* other) {
    if (job.has(one) && job.has(other)) job.fail(other, std::string("stands beside ") + one);
    return job.has(one) || job.has(other);
}

Options withoutWhatTheJobSays(const JsonObject& job, const Options& common) {
    Options options = common;
    if (hasEither(job, "text", "text-file")) {
        options.text.reset();
        options.textFile.reset();
    }
    if (hasEither(job, "style", "preset")) {
        options.style.reset();
        options.preset.reset();
    }
    return options;
}

Style readInlineStyle(JsonValue json) {
    try {
        return readStyle(json);
    } catch (const StyleError& error) {
        throw ToolError(std::string("style.") + error.what());
    }
}

const std::string& checkedString(const JsonObject& job, const Setting& setting,
                                 const std::string& text) {
    if (setting.isPositional) return text;
    if (text.find('\0') != std::string::npos) job.fail(setting.name, "has a NUL character");
    if (text == "-") job.fail(setting.name, "must name a file: jobs have no standard input or output");
    return text;
}

/// The values of a key as the command line would give them; more than one of a list alone.
std::vector<std::string> valuesOf(const JsonObject& job, const Setting& setting) {
    const std::string& name = setting.name;
    switch (setting.kind) {
        case Setting::Kind::flag:
            return {job.boolean(name) ? "true" : "false"};
        case Setting::Kind::number:
            return {job.numeral(name)};
        case Setting::Kind::length:
            return {job.value(name).isNumber() ? job.numeral(name) : job.string(name)};
        case Setting::Kind::list:
            return job.value(name).isArray() ? job.strings(name, {1, kMostFonts})
                                             : std::vector<std::string>{job.string(name)};
        default:
            return {job.string(name)};
    }
}

void readKey(const JsonObject& job, const Setting& setting, Options& options) {
    const std::vector<std::string> values = valuesOf(job, setting);
    try {
        if (setting.forget) setting.forget(options);
        for (const std::string& value : values)
            setting.read(options, checkedString(job, setting, value));
    } catch (const ToolError& error) {
        job.fail(setting.name, error.what());
    }
}

void requirePicture(const Options& options) {
    if (!options.output) throw ToolError("output: missing; the PNG file to write");
    if (!options.text && !options.textFile) {
        throw ToolError("text: missing; a job has text or text-file");
    }
}

Options readJob(const JsonObject& job, const Options& common) {
    Options options = withoutWhatTheJobSays(job, common);
    for (const std::string_view key : job.keys()) {
        if (key == "style" && job.value(key).isObject()) {
            options.inlineStyle = readInlineStyle(job.value(key));
        } else {
            readKey(job, settingNamed(key), options);
        }
    }
    requirePicture(options);
    checkCanvasOf(options);
    checkStandardOutput(options);
    return options;
}

}  // namespace

Options parseJob(const std::string& line, const Options& common) {
    const JsonDocument document = parseLine(line);
    try {
        return readJob(JsonObject(document.root(), "", jobKeys()), common);
    } catch (const StyleError& error) {
        throw ToolError(error.what());
    }
}

}  // namespace vorelpaint
