#pragma once

#include <cstddef>
#include <list>
#include <memory>
#include <utility>

namespace vorelpaint {

/// The last few things that were made, each under what it was made of. Where there are as many as are
/// kept, the one that was asked for the longest ago makes room; who holds it still has it.
template <typename Key, typename Thing>
class Shelf {
  public:
    explicit Shelf(size_t most) : mMost(most) {}

    /// Null when there is none under this key.
    std::shared_ptr<Thing> find(const Key& key) {
        for (auto it = mEntries.begin(); it != mEntries.end(); ++it) {
            if (!(it->first == key)) continue;
            mEntries.splice(mEntries.begin(), mEntries, it);
            return it->second;
        }
        return nullptr;
    }

    /// Keeps it in place of what was under the key.
    void keep(const Key& key, std::shared_ptr<Thing> thing) {
        if (find(key)) mEntries.pop_front();
        if (mEntries.size() == mMost) mEntries.pop_back();
        mEntries.emplace_front(key, std::move(thing));
    }

  private:
    size_t mMost;
    std::list<std::pair<Key, std::shared_ptr<Thing>>>
        mEntries;  ///< the last one that was asked for first
};

}  // namespace vorelpaint
