#pragma once

#include <vector>

#include "dpxlsx/model/host/i_read_only_collection.h"
#include "dpxlsx/model/string.h"

namespace dp {

template <class T>
class ReadOnlyCollection;

// Keys handed to the host.
template <>
class DPXLSX_API ReadOnlyCollection<int> : public IReadOnlyCollection<int> {
  public:
    ReadOnlyCollection();
    ~ReadOnlyCollection() override;

    unsigned long Count() const override;
    int Item(unsigned long index) const override;

    std::vector<int> items;
};

template <class T>
class ReadOnlyStringCollection;

// Texts handed to the host. Item() gives out the stored strings themselves.
template <>
class DPXLSX_API ReadOnlyStringCollection<IString&> : public IReadOnlyCollection<IString&> {
  public:
    ReadOnlyStringCollection();
    ~ReadOnlyStringCollection() override;

    unsigned long Count() const override;
    IString& Item(unsigned long index) const override;

    // Mutable, because the interface hands out modifiable strings from a const collection.
    mutable std::vector<String> items;
};

}  // namespace dp
