#pragma once

#include <cstdint>
#include <optional>
#include <string>

namespace vorelpaint {

/// The names of numbered files: "frame_%05d.png" has five digits at least.
class NumberedName {
  public:
    /// A file's name has one %d or %0Nd, N from 1 to 9, and %% for %; its directory is as it is written.
    /// Nothing for any other name.
    static std::optional<NumberedName> parse(const std::string& path);

    std::string with(int64_t number) const;

  private:
    std::string mBefore;
    std::string mBehind;
    size_t mDigits = 0;
};

}  // namespace vorelpaint
