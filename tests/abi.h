#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <iterator>
#include <sstream>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

// What a host compiled elsewhere knows of an object: the order of its virtual operations and of its
// fields, and the rules of the Itanium C++ ABI. Nothing here uses the library's own declarations.
namespace raw {

inline std::vector<std::string> words(const std::string& text) {
    std::istringstream stream(text);
    return {std::istream_iterator<std::string>(stream), {}};
}

// The operations of a table in their order, separated by spaces; "~ ~" is the pair of destructors.
inline std::size_t slotOf(const std::string& slots, std::string_view operation) {
    const std::vector<std::string> names = words(slots);
    const auto found = std::find(names.begin(), names.end(), operation);
    EXPECT_NE(found, names.end()) << operation;
    return static_cast<std::size_t>(found - names.begin());
}

// Calls the operation in `slot` of the table that the object's first word points to.
template <class Result, class... Arguments>
Result call(const void* object, std::size_t slot, Arguments... arguments) {
    using Function = Result (*)(const void*, Arguments...);
    void* const* table = *static_cast<void* const* const*>(object);
    return reinterpret_cast<Function>(table[slot])(object, arguments...);
}

// A field's size and alignment by the letter of its type: bool, 32-bit int, double, pointer, text
// (std::string), string object, vector, collection object, map, or a size of its own.
struct Type {
    std::size_t size;
    std::size_t alignment;
};
inline Type typeOf(const std::string& letter) {
    if (letter == "b") return {1, 1};
    if (letter == "i") return {4, 4};
    if (letter == "4i") return {16, 4};
    if (letter == "d" || letter == "p") return {8, 8};
    if (letter == "t" || letter == "c") return {32, 8};
    if (letter == "s") return {40, 8};
    if (letter == "v") return {24, 8};
    if (letter == "m") return {48, 8};
    return {std::stoul(letter), 8};
}

// Where and what a field is. `fields` lists "name:type" in order, behind `start` bytes of table
// pointers.
struct Field {
    std::string type;
    std::size_t offset;
};
inline Field fieldOf(const std::string& fields, const std::string& name, std::size_t start) {
    std::size_t offset = start;
    for (const std::string& field : words(fields)) {
        const std::size_t colon = field.find(':');
        const std::string letter = field.substr(colon + 1);
        const Type type = typeOf(letter);
        offset = (offset + type.alignment - 1) / type.alignment * type.alignment;
        if (field.substr(0, colon) == name) return {letter, offset};
        offset += type.size;
    }
    ADD_FAILURE() << "no field " << name;
    return {"b", 0};
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

// Whatever is written into the field comes back from the operation.
template <class T>
void expectEcho(void* object, std::size_t offset, const void* facet, std::size_t slot, T other) {
    const T before = peek<T>(object, offset);
    poke(object, offset, other);
    EXPECT_EQ(call<T>(facet, slot), other);
    poke(object, offset, before);
}

// An object, the table that a host calls it through (`facet`, which is the object itself or its
// second base), and what the host knows of both.
struct Shape {
    void* object;
    void* facet;
    std::string slots;
    std::string fields;
    std::size_t start = 8;
};

// Checks pairs "operation=field": each operation answers its field, or points to an embedded one.
inline void expectGetters(const Shape& shape, const std::string& getters) {
    for (const std::string& getter : words(getters)) {
        SCOPED_TRACE(getter);
        const std::size_t equals = getter.find('=');
        const std::size_t slot = slotOf(shape.slots, getter.substr(0, equals));
        const Field field = fieldOf(shape.fields, getter.substr(equals + 1), shape.start);
        if (field.type == "b")
            expectEcho(shape.object, field.offset, shape.facet, slot,
                       !peek<bool>(shape.object, field.offset));
        else if (field.type == "i")
            expectEcho(shape.object, field.offset, shape.facet, slot, 0x5A5A1234);
        else if (field.type == "d")
            expectEcho(shape.object, field.offset, shape.facet, slot, 1.25);
        else if (field.type == "p")
            EXPECT_EQ(call<void*>(shape.facet, slot), peek<void*>(shape.object, field.offset));
        else
            EXPECT_EQ(call<char*>(shape.facet, slot),
                      static_cast<char*>(shape.object) + field.offset);
    }
}

}  // namespace raw
