#pragma once

#include <cstddef>
#include <cstdint>
#include <iterator>
#include <list>
#include <memory>
#include <utility>

namespace vorelcompose {

/// The last few things that were made, each under what it was made of: so many, and of so much weight in
/// all. The one that was asked for the longest ago makes room; who holds it still has it.
template <typename Key, typename Thing>
class Shelf {
  public:
    explicit Shelf(size_t most, size_t mostWeight = SIZE_MAX) : mMost(most), mMostWeight(mostWeight) {}

    /// Null when there is none under this key.
    std::shared_ptr<Thing> find(const Key& key) {
        for (auto it = mEntries.begin(); it != mEntries.end(); ++it) {
            if (!(it->key == key)) continue;
            mEntries.splice(mEntries.begin(), mEntries, it);
            return it->thing;
        }
        return nullptr;
    }

    /// Keeps it in place of what was under the key, unless it is too heavy by itself.
    void keep(const Key& key, std::shared_ptr<Thing> thing, size_t weight = 1) {
        if (find(key)) drop(mEntries.begin());
        if (weight > mMostWeight) return;
        while (!mEntries.empty() && (mEntries.size() >= mMost || mWeight > mMostWeight - weight))
            drop(std::prev(mEntries.end()));
        mEntries.push_front({key, std::move(thing), weight});
        mWeight += weight;
    }

  private:
    struct Entry {
        Key key;
        std::shared_ptr<Thing> thing;
        size_t weight;
    };

    void drop(typename std::list<Entry>::iterator entry) {
        mWeight -= entry->weight;
        mEntries.erase(entry);
    }

    size_t mMost;
    size_t mMostWeight;
    size_t mWeight = 0;
    std::list<Entry> mEntries;  ///< the last one that was asked for first
};

}  // namespace vorelcompose
