#pragma once

#include <functional>
#include <string>
#include <string_view>
#include <vector>

#include "options.h"

namespace vorelpaint {

/// One thing that the program can be asked for by name.
struct Setting {
    /// What a value looks like in a job of a batch: true or false, a string, a number, a length, which
    /// is either of these, or a string or a list of them. On the command line a flag stands alone, and a
    /// list is an option that may stand several times.
    enum class Kind { flag, text, number, length, list };
    using Read = std::function<void(Options&, const std::string&)>;

    std::string name;    ///< "output": the option --output, the key "output" of a job
    std::string letter;  ///< "o" where -o stands for it, else empty
    std::string value;   ///< what stands behind it: "PX"; "left|right" lists the words; empty for a flag
    std::string initial;      ///< what is taken where nothing is given; empty where that is nothing
    std::string group;        ///< the heading that it stands under
    std::string description;  ///< without a full stop
    Kind kind;
    bool inJobs;        ///< whether a job of a batch may have it as a key
    bool isPositional;  ///< stands on the command line without its name
    Read read;  ///< takes a value over; of a flag "true" or "false". Throws ToolError: "'0' is no whole
                ///< number ..."
    std::function<void(Options&)> forget{};  ///< of a list: takes what it has back, before the first one
};

/// Everything there is to ask for: the one list behind the command line, the jobs of a batch, the manual
/// page and the completions of the shells. The first is --help, which has nothing to read.
const std::vector<Setting>& settings();

/// The setting of this name, which there must be.
const Setting& settingNamed(std::string_view name);

/// "--output", or "TEXT" for the one without a name on the command line.
std::string optionName(const Setting& setting);

/// The words among which its value is chosen: "left", "center", "right" of "left|center|right".
std::vector<std::string> wordsOf(const Setting& setting);

}  // namespace vorelpaint
