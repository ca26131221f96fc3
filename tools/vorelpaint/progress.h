#pragma once

#include <chrono>
#include <cstddef>
#include <string>

namespace vorelpaint {

/// How far a long piece of work is, as a bar on the terminal; nothing where there is none. The bar goes
/// with the object.
class Progress {
  public:
    /// `total` steps of what `noun` names ("pictures"); 0 when their number is not known.
    Progress(std::string noun, size_t total);
    ~Progress();
    Progress(const Progress&) = delete;
    Progress& operator=(const Progress&) = delete;

    /// One more step is done.
    void advance();

    /// "[##########----------] 12 of 24 pictures", or "12 pictures" of an unknown total.
    static std::string line(size_t done, size_t total, const std::string& noun);

  private:
    using Clock = std::chrono::steady_clock;

    std::string mNoun;
    size_t mTotal;
    size_t mDone = 0;
    Clock::time_point mNextDrawing;
};

}  // namespace vorelpaint
