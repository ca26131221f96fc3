#include "batch.h"

#include <deque>
#include <exception>
#include <memory>
#include <new>
#include <optional>
#include <string>
#include <utility>

#include "batch_job.h"
#include "console.h"
#include "crew.h"
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

/// What went wrong in `action`, if anything did.
template <typename Action>
std::optional<std::string> faultOf(Action action) {
    try {
        action();
        return std::nullopt;
    } catch (const std::bad_alloc&) {
        return "not enough memory";
    } catch (const std::exception& error) {
        return error.what();
    }
}

/// The lines that are jobs, each with its number among them: blank ones are none.
class JobReader {
  public:
    explicit JobReader(const std::string& path) : mLines(path) {}

    /// Reads a line if it is there; whether there is another.
    bool read() {
        mLine = mLines.next(kMaxJobBytes);
        if (mLine && isBlank(*mLine)) mLine->clear();
        if (isJob()) ++mJobs;
        return mLine.has_value();
    }

    bool isJob() const { return mLine && !mLine->empty(); }  ///< what was read
    const std::string& line() const { return *mLine; }
    size_t lineNumber() const { return mLines.number(); }
    size_t jobNumber() const { return mJobs; }

    LineReader& lines() { return mLines; }
    void rewind() {
        mLines.rewind();
        mJobs = 0;
    }

  private:
    LineReader mLines;
    std::optional<std::string> mLine;
    size_t mJobs = 0;
};

bool isInShard(const Options& common, size_t jobNumber) {
    if (!common.shard) return true;
    const auto count = static_cast<size_t>(common.shard->count);
    return (jobNumber - 1) % count + 1 == static_cast<size_t>(common.shard->index);
}

/// The number of jobs that are to be done. Throws when two of all have one output, before anything is
/// painted. Other faults are found where the jobs are painted.
size_t checkAhead(JobReader& reader, const Options& common) {
    OutputNames outputs;
    size_t jobs = 0;
    size_t clashes = 0;
    while (reader.read()) {
        if (!reader.isJob()) continue;
        if (isInShard(common, reader.jobNumber())) ++jobs;
        std::optional<Options> job;
        if (faultOf([&] { job = parseJob(reader.line(), common); })) continue;
        const auto clash = faultOf([&] { claimOutput(outputs, *job, reader.lineNumber()); });
        if (!clash) continue;
        sayOfLine(reader.lineNumber(), *clash);
        ++clashes;
    }
    const size_t all = reader.jobNumber();
    reader.rewind();
    if (clashes == 0) return jobs;
    throw ToolError("nothing is painted: of " + std::to_string(all) + " jobs " +
                    std::to_string(clashes) + " would replace the picture of another");
}

/// Reads the jobs and hands their pictures over, in the order of the lines. What lies between, the
/// painting, is done by a crew.
class BatchRun {
  public:
    BatchRun(const Options& common, JobReader& reader, size_t jobs)
        : mCommon(common), mReader(reader), mProgress("pictures", jobs), mCrew(threadsFor(common)) {}

    BatchResult run() {
        try {
            while (readOn())
                handOverDone();
        } catch (...) {  // of the batch itself: the jobs before that are done all the same
            handOverAll();
            throw;
        }
        handOverAll();
        return mResult;
    }

  private:
    struct Job {
        size_t line = 0;
        Options options;
        bool isToDo = true;
        PaintedPicture picture;
        std::optional<std::string> fault;

        /// Throws std::bad_alloc; any other failure is its fault.
        void paint(Workbench& bench) {
            if (!isToDo) return;
            try {
                picture = painted(options, composed(options, bench));
            } catch (const std::bad_alloc&) {
                throw;
            } catch (const std::exception& error) {
                fault = error.what();
            }
        }
    };

    /// Takes the next line, or waits until it can; whether there may be more.
    bool readOn() {
        if (mCrew.isFull()) {
            mCrew.wait();
            return true;
        }
        if (!mCrew.isEmpty() && !mReader.lines().isReady()) {
            mCrew.wait(mReader.lines().descriptor());
            return true;
        }
        if (!mReader.read()) return false;
        if (mReader.isJob()) begin();
        return true;
    }

    /// Of a job of another shard the output is claimed all the same.
    void begin() {
        auto job = std::make_unique<Job>();
        job->line = mReader.lineNumber();
        job->fault = faultOf([&] {
            job->options = parseJob(mReader.line(), mCommon);
            claimOutput(mOutputs, job->options, job->line);
        });
        if (!isInShard(mCommon, mReader.jobNumber())) return;
        job->isToDo = !job->fault && !(mCommon.skipExisting && isWritten(*job->options.output));
        give(std::move(job));
    }

    void give(std::unique_ptr<Job> job) {
        mJobs.push_back(std::move(job));
        try {
            mCrew.give([given = mJobs.back().get()](Workbench& bench) { given->paint(bench); });
        } catch (...) {
            mJobs.pop_back();
            throw;
        }
    }

    void handOverDone() {
        while (!mCrew.isEmpty() && mCrew.isFirstDone())
            handOverFirst();
    }

    void handOverAll() {
        while (!mCrew.isEmpty())
            handOverFirst();
    }

    /// The first job, when it is painted. What has no memory beside others may have enough alone.
    std::unique_ptr<Job> takeFirst() {
        mCrew.wait();
        std::unique_ptr<Job> job = std::move(mJobs.front());
        mJobs.pop_front();
        try {
            mCrew.take();
        } catch (const std::bad_alloc&) {
            mCrew.waitForAll();
            Workbench bench;
            job->fault = faultOf([&] { job->paint(bench); });
        }
        return job;
    }

    void handOverFirst() {
        const std::unique_ptr<Job> job = takeFirst();
        const auto sayHere = [&](const std::string& what) { sayOfLine(job->line, what); };
        if (!job->fault && job->isToDo) {
            job->fault = faultOf([&] {
                handOver(job->options, job->picture,
                         [&](const std::string& note) { sayHere("note: " + note); });
            });
        }
        if (job->fault) {
            sayHere(*job->fault);
            ++mResult.failed;
        }
        ++mResult.jobs;
        mProgress.advance();
    }

    const Options& mCommon;
    JobReader& mReader;
    Progress mProgress;
    OutputNames mOutputs;
    BatchResult mResult;
    std::deque<std::unique_ptr<Job>> mJobs;
    Crew mCrew;  ///< ends before the jobs do that it works at
};

}  // namespace

BatchResult paintBatch(const Options& common) {
    JobReader reader(common.batch.value());
    const size_t jobs = reader.lines().canRewind() ? checkAhead(reader, common) : 0;
    return BatchRun(common, reader, jobs).run();
}

}  // namespace vorelpaint
