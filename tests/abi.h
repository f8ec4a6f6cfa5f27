#pragma once

#include <cxxabi.h>
#include <dlfcn.h>
#include <elf.h>
#include <link.h>

#include <algorithm>
#include <cctype>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <iterator>
#include <map>
#include <memory>
#include <sstream>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "tests/case_table.h"

// An object as a separately compiled host knows it: by the order of its virtual operations and fields, and by the rules
// of the Itanium C++ ABI. Nothing here uses the library's own declarations.
namespace raw {

inline std::vector<std::string> words(const std::string& text) {
    std::istringstream stream(text);
    return {std::istream_iterator<std::string>(stream), {}};
}

// The slots and fields of a class, read from the table of the contract.
struct Contract {
    std::vector<std::string> slots;
    std::vector<std::string> fields;  // "name:type"
};
inline Contract contractOf(const std::string& name) {
    for (const auto& row : caseTable("host_contract.txt"))
        if (row[0] == name) return {words(row[1]), words(row[2])};
    ADD_FAILURE() << "no contract for " << name;
    return {};
}

inline std::size_t slotOf(const Contract& contract, std::string_view operation) {
    const auto found = std::find(contract.slots.begin(), contract.slots.end(), operation);
    EXPECT_NE(found, contract.slots.end()) << operation;
    return static_cast<std::size_t>(found - contract.slots.begin());
}

// Calls the operation in `slot` of the table that the object's first word points to.
template <class Result, class... Arguments>
Result call(const void* object, std::size_t slot, Arguments... arguments) {
    using Function = Result (*)(const void*, Arguments...);
    void* const* table = *static_cast<void* const* const*>(object);
    return reinterpret_cast<Function>(table[slot])(object, arguments...);
}

// The mangled names of the program's symbols, by address.
inline std::multimap<std::uintptr_t, std::string> programSymbols() {
    std::ifstream file("/proc/self/exe", std::ios::binary);
    const auto read = [&file](auto items, std::uint64_t offset) {
        file.seekg(static_cast<std::streamoff>(offset));
        file.read(reinterpret_cast<char*>(items.data()), static_cast<std::streamsize>(items.size() * sizeof items[0]));
        return items;
    };
    const ElfW(Ehdr) header = read(std::vector<ElfW(Ehdr)>(1), 0)[0];
    const auto sections = read(std::vector<ElfW(Shdr)>(header.e_shnum), header.e_shoff);
    std::multimap<std::uintptr_t, std::string> names;
    for (const ElfW(Shdr) & section : sections) {
        if (section.sh_type != SHT_DYNSYM) continue;
        const ElfW(Shdr)& texts = sections[section.sh_link];
        const std::string text = read(std::string(texts.sh_size, '\0'), texts.sh_offset);
        for (const ElfW(Sym) & symbol :
             read(std::vector<ElfW(Sym)>(section.sh_size / sizeof(ElfW(Sym))), section.sh_offset))
            names.emplace(symbol.st_value, text.c_str() + symbol.st_name);
    }
    return names;
}

// "name(types)" of a member function.
inline std::string operationName(const std::string& mangled) {
    const std::unique_ptr<char, void (*)(void*)> name(abi::__cxa_demangle(mangled.c_str(), nullptr, nullptr, nullptr),
                                                      std::free);
    std::string text = name ? name.get() : "";
    if (const auto tag = text.find("[abi:cxx11]"); tag != text.npos) text.erase(tag, 11);
    const auto scope = text.rfind("::", text.find('('));
    return scope == text.npos ? text : text.substr(scope + 2);
}

// All names of the operation in a slot: the optimiser merges functions with equal bodies into one.
inline std::vector<std::string> operationsIn(const void* object, std::size_t slot) {
    static const auto symbols = programSymbols();
    void* const operation = (*static_cast<void* const* const*>(object))[slot];
    Dl_info unused{};
    link_map* program = nullptr;
    if (!dladdr1(operation, &unused, reinterpret_cast<void**>(&program), RTLD_DL_LINKMAP)) return {};
    const auto [begin, end] = symbols.equal_range(reinterpret_cast<std::uintptr_t>(operation) - program->l_addr);
    std::vector<std::string> names;
    for (auto symbol = begin; symbol != end; ++symbol) names.push_back(operationName(symbol->second));
    return names;
}

// Size and alignment of a field by its type in the table.
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

// The offset of a field, behind `start` bytes of table pointers, and its type, which is empty when there is no such
// field.
struct Field {
    std::string type;
    std::size_t offset = 0;
};
inline Field fieldOf(const Contract& contract, const std::string& name, std::size_t start = 8) {
    std::size_t offset = start;
    for (const std::string& field : contract.fields) {
        const std::size_t colon = field.find(':');
        const std::string letter = field.substr(colon + 1);
        const Type type = typeOf(letter);
        offset = (offset + type.alignment - 1) / type.alignment * type.alignment;
        if (field.substr(0, colon) == name) return {letter, offset};
        offset += type.size;
    }
    return {};
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

// Checks that the operation returns whatever is written into the field.
template <class T>
void expectEcho(void* object, std::size_t offset, const void* facet, std::size_t slot, T other) {
    const T before = peek<T>(object, offset);
    poke(object, offset, other);
    EXPECT_EQ(call<T>(facet, slot), other);
    poke(object, offset, before);
}

// The name of the field that an operation returns; empty for an operation that computes its result.
inline std::string fieldBehind(const std::string& operation) {
    static const std::map<std::string, std::string> others = {
        {"IsFormatDirty", "formatDirty"},
        {"GetAuto", "autoFormat"},
        {"ShowFullPrecision", "showsFullPrecision"},
        {"GetFormatString", "pattern"},
        {"GetOwnDecimalPlaces", "percentDecimalPlaces"},
        {"Attached", "attached"},
        {"IsCopy", "isCopy"},
        {"UseAllRows", "useAllRows"},
        {"GetConstView", "view"},
        {"UseDefaultVariableBody", "useDefaultVariableBody"},
        {"GetOSVersion", "osVersion"},
        {"GetConstFormulaManager", "formulaManager"},
        // These have arguments, or return the characters of a string.
        {"GetDecimalPlaces", ""},
        {"GetDateTimeParameters", ""},
        {"GetRows", ""},
        {"GetListSeparator", ""},
        {"GetDecimalSymbol", ""},
        {"GetFormula", ""},
        {"GetTerms", ""}};
    if (const auto other = others.find(operation); other != others.end()) return other->second;
    if (operation.substr(0, 3) != "Get" || operation.size() == 3) return "";
    std::string field = operation.substr(3);
    field[0] = static_cast<char>(std::tolower(field[0]));
    return field;
}

// Checks every operation in the table at `facet` (the object itself or its second base) that is a getter: it must
// return its field, or a pointer to it when the field is an object. Returns the number of getters.
inline int expectGetters(void* object, const void* facet, const Contract& table, const Contract& layout,
                         std::size_t start = 8) {
    int checked = 0;
    for (std::size_t slot = 2; slot < table.slots.size(); ++slot) {
        SCOPED_TRACE(table.slots[slot]);
        const Field field = fieldOf(layout, fieldBehind(table.slots[slot]), start);
        if (field.type.empty()) continue;
        ++checked;
        if (field.type == "b")
            expectEcho(object, field.offset, facet, slot, !peek<bool>(object, field.offset));
        else if (field.type == "i")
            expectEcho(object, field.offset, facet, slot, 0x5A5A1234);
        else if (field.type == "d")
            expectEcho(object, field.offset, facet, slot, 1.25);
        else if (field.type == "p")
            expectEcho(object, field.offset, facet, slot, object);
        else
            EXPECT_EQ(call<char*>(facet, slot), static_cast<char*>(object) + field.offset);
    }
    return checked;
}

}  // namespace raw
