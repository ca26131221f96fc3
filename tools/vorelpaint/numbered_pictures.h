#pragma once

#include <cstddef>
#include <cstdint>
#include <deque>
#include <functional>
#include <memory>
#include <vector>

#include "crew.h"
#include "numbered_name.h"
#include "progress.h"

namespace vorelpaint {

/// Numbered files that are made on threads and written in the order in which they are given. A few are
/// in memory at a time.
class NumberedPictures {
  public:
    using Make = std::function<std::vector<uint8_t>(Workbench&)>;  ///< on any thread
    class File;

    /// `unit` and `count` are what is told of the progress.
    NumberedPictures(NumberedName name, int threads, const char* unit, size_t count);
    ~NumberedPictures();

    /// Takes a file's making over. Like finish(), throws what the making of an earlier one threw, or
    /// ToolError where one cannot be written.
    std::shared_ptr<File> add(int64_t number, Make make);

    /// The bytes of an earlier file under another number.
    void repeat(int64_t number, std::shared_ptr<File> file);

    void finish();  ///< writes all that are left

  private:
    struct Entry {
        int64_t number;
        std::shared_ptr<File> file;
    };

    void push(Entry entry);
    bool isFirstReady() const;
    void writeFirst();

    NumberedName mName;
    Progress mProgress;
    std::deque<Entry> mEntries;
    Crew mCrew;
};

}  // namespace vorelpaint
