#pragma once

#include <functional>
#include <string>
#include <vector>

#include "compose/error.h"

namespace vorelcompose {

/// Takes a line that says what is odd, but by itself no reason to stop.
using Note = std::function<void(const std::string& line)>;

/// Notes that wait until nothing can fail any more: a fault stands alone.
class HeldNotes {
  public:
    Note taker() {
        return [this](const std::string& line) { mLines.push_back(line); };
    }
    /// What a strict request does with them: throws the first as ComposeError.
    void refuse() const {
        if (!mLines.empty()) throw ComposeError(mLines.front());
    }
    void giveTo(const Note& note) const {
        for (const std::string& line : mLines)
            note(line);
    }

  private:
    std::vector<std::string> mLines;
};

}  // namespace vorelcompose
