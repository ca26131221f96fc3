#pragma once

#include <filesystem>
#include <string>
#include <vector>

namespace vorel_test {

/// A directory of its own for one test, removed with everything in it.
class TempDir {
  public:
    TempDir();
    ~TempDir();
    TempDir(const TempDir&) = delete;
    TempDir& operator=(const TempDir&) = delete;

    const std::filesystem::path& path() const { return mPath; }
    std::string file(const std::string& name) const { return (mPath / name).string(); }
    std::string write(const std::string& name, const std::string& bytes) const;  ///< the file's path
    std::vector<std::string> list() const;                                       ///< sorted names

  private:
    std::filesystem::path mPath;
};

std::string readBytes(const std::filesystem::path& path);

}  // namespace vorel_test
