#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

// What a host compiled elsewhere knows of an object: the order of its virtual operations and of its
// fields, and the rules of the Itanium C++ ABI. Nothing here uses the library's own declarations.
namespace raw {

using Slots = std::vector<std::string_view>;

inline std::size_t slotOf(const Slots& slots, std::string_view operation) {
    const auto found = std::find(slots.begin(), slots.end(), operation);
    EXPECT_NE(found, slots.end()) << operation;
    return static_cast<std::size_t>(found - slots.begin());
}

// Calls the operation in `slot` of the table that the object's first word points to.
template <class Result, class... Arguments>
Result call(const void* object, std::size_t slot, Arguments... arguments) {
    using Function = Result (*)(const void*, Arguments...);
    void* const* table = *static_cast<void* const* const*>(object);
    return reinterpret_cast<Function>(table[slot])(object, arguments...);
}

struct Type {
    std::size_t size;
    std::size_t alignment;
};
inline constexpr Type kBool{1, 1}, kInt{4, 4}, kDouble{8, 8}, kPointer{8, 8}, kStdString{32, 8},
    kString{40, 8}, kVector{24, 8}, kCollection{32, 8}, kMap{48, 8}, kColumnView{24, 8},
    kColumnOrdering{48, 8};

struct Field {
    std::string_view name;
    Type type;
};
using Fields = std::vector<Field>;

// Where a field lies when the first one follows `start` bytes of table pointers or base fields.
inline std::size_t offsetOf(const Fields& fields, std::string_view name, std::size_t start) {
    std::size_t offset = start;
    for (const Field& field : fields) {
        const std::size_t alignment = field.type.alignment;
        offset = (offset + alignment - 1) / alignment * alignment;
        if (field.name == name) return offset;
        offset += field.type.size;
    }
    ADD_FAILURE() << "no field " << name;
    return 0;
}

template <class T>
T peek(const void* object, std::size_t offset) {
    T value;
    std::memcpy(&value, static_cast<const char*>(object) + offset, sizeof value);
    return value;
}

template <class T>
void poke(void* object, std::size_t offset, T value) {
    std::memcpy(static_cast<char*>(object) + offset, &value, sizeof value);
}

// An object, the table that a host calls it through (`facet`, which is the object itself or its
// second base), and what the host knows of both.
struct Shape {
    void* object;
    void* facet;
    Slots slots;
    Fields fields;
    std::size_t start;
};

// Checks that an operation answers the field of that place: whatever is written there comes back.
inline void expectGetter(const Shape& shape, std::string_view operation, std::string_view field) {
    SCOPED_TRACE(std::string(operation));
    const std::size_t slot = slotOf(shape.slots, operation);
    const std::size_t offset = offsetOf(shape.fields, field, shape.start);
    const auto entry = std::find_if(shape.fields.begin(), shape.fields.end(),
                                    [&](const Field& f) { return f.name == field; });
    if (entry->type.size == kBool.size) {
        const bool before = peek<bool>(shape.object, offset);
        poke(shape.object, offset, !before);
        EXPECT_EQ(call<bool>(shape.facet, slot), !before);
        poke(shape.object, offset, before);
    } else if (entry->type.size == kInt.size) {
        const auto before = peek<std::int32_t>(shape.object, offset);
        poke(shape.object, offset, std::int32_t{0x5A5A1234});
        EXPECT_EQ(call<std::int32_t>(shape.facet, slot), 0x5A5A1234);
        poke(shape.object, offset, before);
    } else if (entry->type.size == kDouble.size && entry->name.find("ptr:") != 0) {
        const double before = peek<double>(shape.object, offset);
        poke(shape.object, offset, 1.25);
        EXPECT_EQ(call<double>(shape.facet, slot), 1.25);
        poke(shape.object, offset, before);
    } else if (entry->name.find("ptr:") == 0) {
        EXPECT_EQ(call<void*>(shape.facet, slot), peek<void*>(shape.object, offset));
    } else {
        EXPECT_EQ(call<const char*>(shape.facet, slot),
                  static_cast<const char*>(shape.object) + offset);
    }
}

}  // namespace raw
