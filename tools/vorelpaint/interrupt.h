#pragma once

#include <csignal>
#include <string>

/// Leaving nothing half-written behind when a signal ends the program.
namespace vorelpaint {

/// Makes every signal that ends the program, and can be caught, remove the unfinished file and the
/// status before it does so as usual. One that was ignored stays ignored. SIGPIPE and SIGXFSZ end
/// nothing any more: writing fails with their error instead.
void cleanUpOnSignals();

/// While it lives those signals wait.
class HeldSignals {
  public:
    HeldSignals();
    ~HeldSignals();
    HeldSignals(const HeldSignals&) = delete;
    HeldSignals& operator=(const HeldSignals&) = delete;

  private:
    sigset_t mBefore;
};

/// Names the file to remove, or with an empty name none. To be called with signals held, together with
/// the step that makes, renames or removes the file.
void setUnfinishedFile(const std::string& path);

}  // namespace vorelpaint
