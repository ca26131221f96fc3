#pragma once

#include <sys/types.h>

#include <string>
#include <vector>

#include "temp_dir.h"

namespace vorel_test {

struct Outcome {
    int exitCode;  ///< -1 when a signal ended the program
    std::string out;
    std::string err;
};

/// Runs vorelpaint with these arguments and this standard input to its end.
Outcome runVorelpaint(const std::vector<std::string>& arguments, const std::string& input = "");

/// The same with a terminal of `columns` columns for standard error; `err` is what was drawn there, with
/// its control characters.
Outcome runVorelpaintOnTerminal(const std::vector<std::string>& arguments, int columns);

/// What a program finds when it starts.
struct Surroundings {
    int ignoredSignal = 0;     ///< as under nohup; 0 for none
    bool unnamedFiles = true;  ///< whether its file systems have them
    size_t largestFile =
        0;  ///< bytes, beyond which SIGXFSZ ends what does not ignore it; 0 for no limit
    bool closedOutput = false;  ///< standard output is a pipe that nobody reads
    size_t addressSpace = 0;    ///< bytes that it may have mapped; 0 for no limit
    int missingStream = -1;     ///< a standard stream that is not open; -1 for none
};

/// The same, waited for like runVorelpaint, in other surroundings and without input.
Outcome runVorelpaintIn(const Surroundings& surroundings, const std::vector<std::string>& arguments);

/// vorelpaint at work, with neither input nor output. Ended and waited for when it goes out of scope.
class RunningVorelpaint {
  public:
    explicit RunningVorelpaint(const std::vector<std::string>& arguments,
                               const Surroundings& surroundings = {});
    ~RunningVorelpaint();
    RunningVorelpaint(const RunningVorelpaint&) = delete;
    RunningVorelpaint& operator=(const RunningVorelpaint&) = delete;

    pid_t id() const { return mChild; }
    void send(int signal) const;

    bool freeze() const;  ///< whether it stands still; it may have ended instead
    void thaw() const;

    /// Whether it has a file in this directory open that is not finished: of a passing name, or of none.
    bool isWritingIn(const std::filesystem::path& directory) const;

    bool hasEnded() const;  ///< wait() tells how
    int wait();             ///< the status as waitpid gives it

  private:
    pid_t mChild;
};

/// The same with standard output going to `outPath`.
Outcome runVorelpaintInto(const std::string& outPath, const std::vector<std::string>& arguments);

/// From now on every file that this process closes answers that there is no space left.
void refuseToClose();

}  // namespace vorel_test
