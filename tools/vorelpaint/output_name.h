#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>

namespace vorelpaint {

/// Whether a file name ends like another kind of file than PNG. Endings that say nothing, such as those
/// of mktemp, do not.
bool namesOtherKind(std::string_view path);

/// Whether there is a file with something in it already where `path` leads to: files take their names
/// when they are whole. Devices, pipes and open files are always there to be written.
bool isWritten(const std::string& path);

/// The files that the jobs of a batch write.
class OutputNames {
  public:
    /// Notes that a line writes to `path`; the line that does so already, if one does. Paths are the
    /// same that lead to the same file, also through links. Devices, pipes and open files are for all.
    std::optional<size_t> claim(const std::string& path, size_t line);

  private:
    std::unordered_map<std::string, size_t> mLines;
};

}  // namespace vorelpaint
