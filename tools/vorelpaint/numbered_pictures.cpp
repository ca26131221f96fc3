#include "numbered_pictures.h"

#include <utility>

#include "file_io.h"

namespace vorelpaint {
namespace {

/// Repeated ones need no thread, so these alone bound them.
constexpr size_t kMostEntries = 256;

}  // namespace

class NumberedPictures::File {
  public:
    std::vector<uint8_t> bytes;
    bool isMade = false;  ///< and taken from the crew
};

NumberedPictures::NumberedPictures(NumberedName name, int threads, const char* unit, size_t count)
    : mName(std::move(name)), mProgress(unit, count), mCrew(threads) {}

NumberedPictures::~NumberedPictures() = default;

std::shared_ptr<NumberedPictures::File> NumberedPictures::add(int64_t number, Make make) {
    while (mCrew.isFull())
        writeFirst();
    auto file = std::make_shared<File>();
    mCrew.give([file, make = std::move(make)](Workbench& bench) { file->bytes = make(bench); });
    push({number, file});
    return file;
}

void NumberedPictures::repeat(int64_t number, std::shared_ptr<File> file) {
    push({number, std::move(file)});
}

void NumberedPictures::finish() {
    while (!mEntries.empty())
        writeFirst();
}

void NumberedPictures::push(Entry entry) {
    mEntries.push_back(std::move(entry));
    while (!mEntries.empty() && (isFirstReady() || mEntries.size() > kMostEntries))
        writeFirst();
}

bool NumberedPictures::isFirstReady() const {
    return mEntries.front().file->isMade || mCrew.isFirstDone();
}

/// A file's first entry is the first that the crew has of those that are not made.
void NumberedPictures::writeFirst() {
    const Entry entry = std::move(mEntries.front());
    mEntries.pop_front();
    if (!entry.file->isMade) mCrew.take();
    entry.file->isMade = true;
    writeFile(mName.with(entry.number), entry.file->bytes);
    mProgress.advance();
}

}  // namespace vorelpaint
