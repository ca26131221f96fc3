#pragma once

#include <cstdio>
#include <filesystem>
#include <memory>
#include <string>

namespace vorelpaint {

/// A file that takes its name in one step when it is whole: until then an older one of that name is
/// untouched, and if it never comes to that nothing is left, also when a signal ends the program. It has
/// no name before where the file system knows such files, else a passing one beside its target.
class NewFile {
  public:
    enum class Kind { unnamed, named };

    /// A replaced file's permissions stay, and its owner and group where the process may give files
    /// away. A named one is made where an unnamed one was asked for and cannot be had. Throws ToolError.
    explicit NewFile(std::filesystem::path target, Kind kind = Kind::unnamed);

    ~NewFile();
    NewFile(const NewFile&) = delete;
    NewFile& operator=(const NewFile&) = delete;

    Kind kind() const { return mPassingName.empty() ? Kind::unnamed : Kind::named; }
    std::FILE* get() const { return mFile.get(); }

    /// Gives it its name; what was written must have been flushed. Throws ToolError.
    void finish();

  private:
    struct Closer {
        void operator()(std::FILE* file) const { std::fclose(file); }
    };

    int openUnnamed() const;
    int openNamed();
    void link() const;
    void rename();
    void removePassing() const;
    [[noreturn]] void fail() const;

    std::filesystem::path mTarget;
    std::string mPassingName;  ///< empty while there is none
    std::unique_ptr<std::FILE, Closer> mFile;
};

}  // namespace vorelpaint
