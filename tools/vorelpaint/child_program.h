#pragma once

#include <sys/types.h>

#include <cstddef>
#include <string>
#include <vector>

namespace vorelpaint {

/// Another program at work, found along PATH and started without a shell: its words are as they are
/// given. It is ended with this program, however that ends (Linux: PR_SET_PDEATHSIG).
class ChildProgram {
  public:
    /// The one stream that this program has the other end of; the other one is /dev/null.
    enum class Stream { input, output };

    /// The number under which the child finds the file that it is given.
    static constexpr int kGivenFile = 3;

    /// `given` is the descriptor of that file, -1 for none. Throws ToolError when there is no such
    /// program.
    ChildProgram(std::vector<std::string> words, Stream stream, int given = -1);

    ~ChildProgram();  ///< ends it if it is still at work
    ChildProgram(const ChildProgram&) = delete;
    ChildProgram& operator=(const ChildProgram&) = delete;

    /// Writes to its input; false, with nothing to be written any more, when it does not read on.
    /// Throws ToolError for any other failure.
    bool write(const void* bytes, size_t size);

    /// What it writes until it closes its output. Throws ToolError beyond `maxBytes`.
    std::string readAll(size_t maxBytes);

    /// Closes the stream and waits for its end. Throws ToolError, with the first line that it wrote to
    /// standard error, when it did not end well, and with one of its last lines, which begins with one
    /// of `faults`, when it ended as if it had.
    void finish(const std::vector<std::string>& faults = {});

  private:
    [[noreturn]] void failToStart(int reason);
    void become(char* const* words, Stream stream, int theirs, int given, int report) const;
    int waitForEnd();
    std::string complaint() const;
    std::string complaintAmong(const std::vector<std::string>& faults) const;

    std::string mName;
    pid_t mChild = -1;
    int mStream = -1;
    int mErrors = -1;  ///< a file in memory: nobody needs to read it while the program is at work
};

}  // namespace vorelpaint
