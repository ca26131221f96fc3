#include "batch.h"

#include <exception>
#include <new>
#include <optional>
#include <string>

#include "batch_job.h"
#include "console.h"
#include "error.h"
#include "line_reader.h"
#include "output_name.h"
#include "painting.h"
#include "progress.h"
#include "ranges.h"

namespace vorelpaint {
namespace {

bool isBlank(const std::string& line) {
    return line.find_first_not_of(" \t\r") == std::string::npos;
}

/// Two jobs of one output would leave one picture of two.
void claimOutput(OutputNames& outputs, const Options& job, size_t line) {
    const std::string& output = job.output.value();
    const std::optional<size_t> other = outputs.claim(output, line);
    if (other) {
        throw ToolError("output: " + inQuotes(output) + " is the file that line " +
                        std::to_string(*other) + " writes");
    }
}

void sayOfLine(size_t number, const std::string& what) {
    say("line " + std::to_string(number) + ": " + what);
}

bool paintJob(const std::string& line, size_t number, const Options& common, OutputNames& outputs,
              Workbench& bench) {
    const auto sayHere = [&](const std::string& what) { sayOfLine(number, what); };
    try {
        const Options job = parseJob(line, common);
        claimOutput(outputs, job, number);
        handOver(job, painted(job, Composition(job, bench)),
                 [&](const std::string& note) { sayHere("note: " + note); });
        return true;
    } catch (const std::bad_alloc&) {
        sayHere("not enough memory");
    } catch (const std::exception& error) {
        sayHere(error.what());
    }
    return false;
}

std::optional<std::string> nextJob(LineReader& lines) {
    std::optional<std::string> line = lines.next(kMaxJobBytes);
    while (line && isBlank(*line))
        line = lines.next(kMaxJobBytes);
    return line;
}

/// The number of jobs. Throws when two of them have one output, before anything is painted. Other faults
/// are found where the jobs are painted.
size_t checkAhead(LineReader& lines, const Options& common) {
    OutputNames outputs;
    size_t jobs = 0;
    size_t clashes = 0;
    while (const std::optional<std::string> line = nextJob(lines)) {
        ++jobs;
        std::optional<Options> job;
        try {
            job = parseJob(*line, common);
        } catch (const ToolError&) {
            continue;
        }
        try {
            claimOutput(outputs, *job, lines.number());
        } catch (const ToolError& error) {
            sayOfLine(lines.number(), error.what());
            ++clashes;
        }
    }
    lines.rewind();
    if (clashes == 0) return jobs;
    throw ToolError("nothing is painted: of " + std::to_string(jobs) + " jobs " +
                    std::to_string(clashes) + " would replace the picture of another");
}

}  // namespace

BatchResult paintBatch(const Options& common) {
    LineReader lines(common.batch.value());
    const size_t jobs = lines.canRewind() ? checkAhead(lines, common) : 0;
    Progress progress("pictures", jobs);
    OutputNames outputs;
    BatchResult result;
    Workbench bench;
    while (const std::optional<std::string> line = nextJob(lines)) {
        ++result.jobs;
        if (!paintJob(*line, lines.number(), common, outputs, bench)) ++result.failed;
        progress.advance();
    }
    return result;
}

}  // namespace vorelpaint
