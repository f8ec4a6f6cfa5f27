#include "dpxlsx/model/collections.h"

#include <cassert>

namespace dp {

ReadOnlyCollection<int>::ReadOnlyCollection() = default;
ReadOnlyCollection<int>::~ReadOnlyCollection() = default;

unsigned long ReadOnlyCollection<int>::Count() const { return items.size(); }

int ReadOnlyCollection<int>::Item(unsigned long index) const {
    assert(index < items.size());
    return items[index];
}

ReadOnlyStringCollection<IString&>::ReadOnlyStringCollection() = default;
ReadOnlyStringCollection<IString&>::~ReadOnlyStringCollection() = default;

unsigned long ReadOnlyStringCollection<IString&>::Count() const { return items.size(); }

IString& ReadOnlyStringCollection<IString&>::Item(unsigned long index) const {
    assert(index < items.size());
    return items[index];
}

}  // namespace dp
