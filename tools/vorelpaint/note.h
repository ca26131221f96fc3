#pragma once

#include <functional>
#include <string>
#include <vector>

namespace vorelpaint {

/// Takes a line that says what is odd, but by itself no reason to stop.
using Note = std::function<void(const std::string& line)>;

/// Notes that wait.
class HeldNotes {
  public:
    Note taker() {
        return [this](const std::string& line) { mLines.push_back(line); };
    }
    void giveTo(const Note& note) const {
        for (const std::string& line : mLines)
            note(line);
    }

  private:
    std::vector<std::string> mLines;
};

}  // namespace vorelpaint
