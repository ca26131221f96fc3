#include "subtitle_reader.h"

#include <algorithm>
#include <array>
#include <cstdio>
#include <optional>
#include <utility>

#include "error.h"
#include "file_io.h"
#include "path_ending.h"
#include "read_value.h"
#include "style/vorelstyle.h"
#include "subtitle_text.h"
#include "trimmed.h"

namespace vorelpaint {
namespace {

using vorelstyle::isSameWord;

constexpr std::string_view kArrow = "-->";

bool isBlank(std::string_view line) {
    return trimmed(line).empty();
}

bool isNumber(std::string_view line) {
    const std::string_view number = trimmed(line);
    return !number.empty() && number.find_first_not_of("0123456789") == std::string_view::npos;
}

bool beginsWith(std::string_view text, std::string_view beginning) {
    return text.substr(0, beginning.size()) == beginning;
}

/// The lines of a file of any system, without their ends.
std::vector<std::string_view> linesOf(std::string_view bytes) {
    std::vector<std::string_view> lines;
    for (size_t at = 0; at < bytes.size();) {
        const size_t end = std::min(bytes.find_first_of("\r\n", at), bytes.size());
        lines.push_back(bytes.substr(at, end - at));
        at = end + (bytes.substr(end, 2) == "\r\n" ? 2 : 1);
    }
    return lines;
}

// --- times ------------------------------------------------------------------------------------------

/// How a format spells the times of its cues.
struct TimeForm {
    std::string_view points;  ///< what may stand before the fraction of a second
    size_t fractionDigits;
    bool needsHours;
    const char* example;
};
constexpr TimeForm kSrtTime{",.", 3, true, "00:00:01,000 --> 00:00:02,500"};
constexpr TimeForm kVttTime{".", 3, false, "00:01.000 --> 00:02.500"};
constexpr TimeForm kAssTime{".", 2, true, "0:00:01.00,0:00:02.50"};

/// A number of so many digits, and no more than `most`.
std::optional<int64_t> digitsIn(std::string_view text, size_t fewest, size_t mostDigits, int64_t most) {
    if (text.size() < fewest || text.size() > mostDigits || !isNumber(text)) return std::nullopt;
    const std::optional<int64_t> number = numberIn<int64_t>(text);
    return number && *number <= most ? number : std::nullopt;
}

/// "1:02:03.500" in milliseconds.
std::optional<int64_t> timeIn(std::string_view text, const TimeForm& form) {
    const size_t point = text.find_last_of(form.points);
    const size_t minuteEnd = text.rfind(':', point);
    if (point == std::string_view::npos || minuteEnd == std::string_view::npos) return std::nullopt;
    const size_t hourEnd = minuteEnd == 0 ? std::string_view::npos : text.rfind(':', minuteEnd - 1);
    const bool hasHours = hourEnd != std::string_view::npos;
    if (!hasHours && form.needsHours) return std::nullopt;
    const size_t minuteBegin = hasHours ? hourEnd + 1 : 0;
    const auto hours = hasHours ? digitsIn(text.substr(0, hourEnd), 1, 6, 999999) : int64_t{0};
    const auto minutes = digitsIn(text.substr(minuteBegin, minuteEnd - minuteBegin), 1, 2, 59);
    const auto seconds = digitsIn(text.substr(minuteEnd + 1, point - minuteEnd - 1), 1, 2, 59);
    const auto fraction =
        digitsIn(text.substr(point + 1), form.fractionDigits, form.fractionDigits, 999);
    if (!hours || !minutes || !seconds || !fraction) return std::nullopt;
    const int64_t ms = form.fractionDigits == 2 ? 10 * *fraction : *fraction;
    return ((*hours * 60 + *minutes) * 60 + *seconds) * 1000 + ms;
}

// --- files ------------------------------------------------------------------------------------------

class SubtitleFile {
  public:
    SubtitleFile(std::string_view bytes, std::string name)
        : mName(std::move(name)), mLines(linesOf(bytes)) {}

    size_t lineCount() const { return mLines.size(); }
    std::string_view line(size_t index) const { return mLines[index]; }

    [[noreturn]] void fail(size_t index, const std::string& fault) const {
        throw ToolError(inQuotes(mName) + ", line " + std::to_string(index + 1) + ": " + fault);
    }
    [[noreturn]] void fail(const std::string& fault) const {
        throw ToolError(inQuotes(mName) + " " + fault);
    }

    /// The lines [begin, end) as they stand.
    std::string joined(size_t begin, size_t end) const {
        std::string text;
        for (size_t i = begin; i < end; ++i)
            text.append(i == begin ? "" : "\n").append(mLines[i]);
        return text;
    }

    /// Takes a cue over whose times stand in a line, unless there is nothing to show.
    void add(size_t index, const std::optional<int64_t>& start, const std::optional<int64_t>& end,
             const TimeForm& form, std::string text, std::vector<std::string> names) {
        if (!start || !end) fail(index, std::string("no times of a cue; write ") + form.example);
        if (*end < *start) {
            fail(index,
                 "the cue ends at " + timeName(*end) + ", before it starts at " + timeName(*start));
        }
        if (*end > kLongestFilmMs) {
            fail(index,
                 "a cue at " + timeName(*end) + "; a film has at most " + timeName(kLongestFilmMs));
        }
        if (*end == *start || text.empty()) return;
        if (mCues.size() == kMostCues) {
            fail(index, "more than " + std::to_string(kMostCues) + " cues");
        }
        mCues.push_back({*start, *end, std::move(text), std::move(names), index + 1});
    }

    std::vector<Cue> takeCues() {
        if (mCues.empty()) fail("has no cue with a text");
        std::stable_sort(mCues.begin(), mCues.end(),
                         [](const Cue& one, const Cue& other) { return one.startMs < other.startMs; });
        return std::move(mCues);
    }

  private:
    std::string mName;
    std::vector<std::string_view> mLines;
    std::vector<Cue> mCues;
};

bool hasArrow(std::string_view line) {
    return line.find(kArrow) != std::string_view::npos;
}

/// Of a line with an arrow; what stands behind the second time says where a cue is placed.
std::pair<std::optional<int64_t>, std::optional<int64_t>> timesIn(std::string_view line,
                                                                  const TimeForm& form) {
    const size_t arrow = line.find(kArrow);
    const std::string_view behind = trimmed(line.substr(arrow + kArrow.size()));
    return {timeIn(trimmed(line.substr(0, arrow)), form),
            timeIn(behind.substr(0, behind.find_first_of(kBlanks)), form)};
}

// --- SubRip -----------------------------------------------------------------------------------------

/// A text may have blank lines: it ends where the next times stand, or their number. Numbers may be
/// missing.
void readSrt(SubtitleFile& file) {
    size_t at = 0;
    for (; at < file.lineCount() && !hasArrow(file.line(at)); ++at) {
        if (!isBlank(file.line(at)) && !isNumber(file.line(at))) {
            file.fail(at, std::string("no number and no times of a cue, which are ") + kSrtTime.example);
        }
    }
    while (at < file.lineCount()) {
        const size_t times = at++;
        while (at < file.lineCount() && !hasArrow(file.line(at)))
            ++at;
        const bool isNumbered = at < file.lineCount() && at - 1 > times && isNumber(file.line(at - 1));
        const auto [start, end] = timesIn(file.line(times), kSrtTime);
        file.add(times, start, end, kSrtTime,
                 textOfSrt(file.joined(times + 1, isNumbered ? at - 1 : at)), {});
    }
}

// --- WebVTT -----------------------------------------------------------------------------------------

bool isNoCue(std::string_view line) {
    const std::string_view word = line.substr(0, line.find_first_of(kBlanks));
    return word == "NOTE" || ((word == "STYLE" || word == "REGION") && trimmed(line) == word);
}

/// A cue's block: an identifier, which may be missing, the times, and the text.
void readVttCue(SubtitleFile& file, size_t begin, size_t end) {
    const bool hasIdentifier = !hasArrow(file.line(begin));
    const size_t times = begin + (hasIdentifier ? 1 : 0);
    if (times == end || !hasArrow(file.line(times))) {
        file.fail(begin, std::string("a block without times, which are ") + kVttTime.example);
    }
    for (size_t i = times + 1; i < end; ++i) {
        if (hasArrow(file.line(i))) file.fail(i, "times within the text of a cue");
    }
    VttText plain = textOfVtt(file.joined(times + 1, end));
    if (hasIdentifier) plain.names.emplace_back(trimmed(file.line(begin)));
    const auto [start, stop] = timesIn(file.line(times), kVttTime);
    file.add(times, start, stop, kVttTime, std::move(plain.text), std::move(plain.names));
}

void readVtt(SubtitleFile& file) {
    const std::string_view head = file.lineCount() == 0 ? "" : file.line(0);
    if (head.substr(0, head.find_first_of(kBlanks)) != "WEBVTT") file.fail(0, "WEBVTT is missing");
    size_t at = 0;
    while (at < file.lineCount() && !file.line(at).empty() && !hasArrow(file.line(at)))
        ++at;
    for (size_t end = at; at < file.lineCount(); at = end + 1) {
        for (end = at; end < file.lineCount() && !file.line(end).empty();)
            ++end;
        if (end > at && !isNoCue(file.line(at))) readVttCue(file, at, end);
    }
}

// --- ASS --------------------------------------------------------------------------------------------

/// Which part of a cue's line is which.
struct AssFormat {
    size_t count = 0;  ///< 0 before the Format line
    size_t start = 0;
    size_t end = 0;
    std::optional<size_t> style = {};
    std::optional<size_t> speaker = {};
};

/// The parts of a line behind its first colon; the last one has all commas that are left.
std::vector<std::string_view> partsBehindColon(std::string_view line, size_t most) {
    std::string_view rest = line.substr(line.find(':') + 1);
    std::vector<std::string_view> parts;
    for (size_t comma = rest.find(','); comma != std::string_view::npos && parts.size() + 1 < most;
         comma = rest.find(',')) {
        parts.push_back(trimmed(rest.substr(0, comma)));
        rest.remove_prefix(comma + 1);
    }
    parts.push_back(rest);
    return parts;
}

AssFormat readAssFormat(const SubtitleFile& file, size_t index) {
    std::vector<std::string_view> names = partsBehindColon(file.line(index), file.line(index).size());
    names.back() = trimmed(names.back());
    const auto placeOf = [&](std::string_view name) -> std::optional<size_t> {
        const auto place = std::find_if(names.begin(), names.end(),
                                        [&](std::string_view each) { return isSameWord(each, name); });
        if (place == names.end()) return std::nullopt;
        return static_cast<size_t>(place - names.begin());
    };
    const std::optional<size_t> start = placeOf("Start");
    const std::optional<size_t> end = placeOf("End");
    if (!start || !end || !isSameWord(names.back(), "Text")) {
        file.fail(index, "a Format without Start, End and, in the last place, Text");
    }
    const std::optional<size_t> speaker = placeOf("Name");
    return {names.size(), *start, *end, placeOf("Style"), speaker ? speaker : placeOf("Actor")};
}

/// A style may stand with the star that some programs write before the name.
std::vector<std::string> assNames(const AssFormat& format, const std::vector<std::string_view>& parts) {
    std::vector<std::string> names;
    if (format.style) {
        const std::string_view style = parts[*format.style];
        names.emplace_back(style.substr(beginsWith(style, "*") ? 1 : 0));
    }
    if (format.speaker) names.emplace_back(parts[*format.speaker]);
    names.erase(std::remove(names.begin(), names.end(), ""), names.end());
    return names;
}

void readAssCue(SubtitleFile& file, const AssFormat& format, size_t index) {
    if (format.count == 0) file.fail(index, "a cue before the Format of [Events]");
    const std::vector<std::string_view> parts = partsBehindColon(file.line(index), format.count);
    if (parts.size() < format.count) {
        file.fail(index, "a cue of " + std::to_string(parts.size()) + " parts; by the Format it has " +
                             std::to_string(format.count));
    }
    file.add(index, timeIn(parts[format.start], kAssTime), timeIn(parts[format.end], kAssTime), kAssTime,
             textOfAss(parts.back()), assNames(format, parts));
}

void readAss(SubtitleFile& file) {
    AssFormat format;
    bool inEvents = false;
    for (size_t i = 0; i < file.lineCount(); ++i) {
        const std::string_view line = trimmed(file.line(i));
        const std::string_view kind = line.substr(0, line.find(':'));
        if (!line.empty() && line.front() == '[') {
            inEvents = isSameWord(line, "[Events]");
        } else if (inEvents && isSameWord(kind, "Format")) {
            format = readAssFormat(file, i);
        } else if (inEvents && isSameWord(kind, "Dialogue")) {
            readAssCue(file, format, i);
        }
    }
}

// --- all formats ------------------------------------------------------------------------------------

using Reader = void (*)(SubtitleFile&);
constexpr std::array<std::pair<std::string_view, Reader>, 4> kReaders{
    {{"srt", readSrt}, {"vtt", readVtt}, {"ass", readAss}, {"ssa", readAss}}};

Reader readerOf(const std::string& path) {
    for (const auto& [known, reader] : kReaders) {
        if (isSameWord(endingOf(path), known)) return reader;
    }
    throw ToolError(inQuotes(path) + " is no subtitle file; .srt, .vtt, .ass and .ssa are read");
}

}  // namespace

std::vector<Cue> subtitlesIn(std::string_view bytes, const std::string& path) {
    const Reader read = readerOf(path);
    if (beginsWith(bytes, "\xFF\xFE") || beginsWith(bytes, "\xFE\xFF")) {
        throw ToolError(inQuotes(path) + " is in UTF-16; subtitles are read in UTF-8");
    }
    if (beginsWith(bytes, "\xEF\xBB\xBF")) bytes.remove_prefix(3);
    SubtitleFile file(bytes, path);
    read(file);
    return file.takeCues();
}

std::vector<Cue> readSubtitles(const std::string& path) {
    readerOf(path);
    return subtitlesIn(readFileOrInput(path, kMaxSubtitleBytes), path);
}

std::string timeName(int64_t ms) {
    std::array<char, 48> name{};
    std::snprintf(name.data(), name.size(), "%02lld:%02lld:%02lld.%03lld",
                  static_cast<long long>(ms / 3600000), static_cast<long long>(ms / 60000 % 60),
                  static_cast<long long>(ms / 1000 % 60), static_cast<long long>(ms % 1000));
    return name.data();
}

}  // namespace vorelpaint
