#pragma once

#include <csignal>
#include <string>

/// Leaving nothing half-written behind when SIGINT, SIGTERM or SIGHUP ends the program.
namespace vorelpaint {

/// Makes those signals remove the unfinished file and the status before they end the program as usual.
/// One that was ignored stays ignored.
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
