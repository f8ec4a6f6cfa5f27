#pragma once

#include <cassert>
#include <utility>
#include <vector>

#include "model/host/i_read_only_collection.h"
#include "model/string.h"

namespace dp {

template <class T>
class ReadOnlyCollection;

// Keys handed to the host.
template <>
class DPXLSX_API ReadOnlyCollection<int> : public IReadOnlyCollection<int> {
  public:
    ReadOnlyCollection() = default;

    unsigned long Count() const override { return items.size(); }
    int Item(unsigned long index) const override {
        assert(index < items.size());
        return items[index];
    }

    std::vector<int> items;
};

template <class T>
class ReadOnlyStringCollection;

// Texts handed to the host. Item() gives out the stored strings themselves.
template <>
class DPXLSX_API ReadOnlyStringCollection<IString&> : public IReadOnlyCollection<IString&> {
  public:
    ReadOnlyStringCollection() = default;

    unsigned long Count() const override { return items.size(); }
    IString& Item(unsigned long index) const override {
        assert(index < items.size());
        return items[index];
    }

    // The interface promises a modifiable string from a collection that is itself only read.
    mutable std::vector<String> items;
};

}  // namespace dp
