#pragma once

#include <cstddef>
#include <memory>

#include <minizip/unzip.h>

namespace dp {

// The bytes of an archive's entries. minizip finds the entry and checks its headers; ISA-L, where
// the library is built with it, inflates several times as fast as zlib does. An entry that is not
// deflated, or that ISA-L finds damaged, is left to minizip, so that the results are the same, with
// one exception: ISA-L takes incomplete Huffman codes, which zlib refuses and no program writes. An
// entry that has them is read if its bytes have the sum that its header claims.
class EntryReader {
  public:
    explicit EntryReader(unzFile archive);
    ~EntryReader();
    EntryReader(const EntryReader&) = delete;
    EntryReader& operator=(const EntryReader&) = delete;

    // Opens the archive's current entry. minizip's result, here and below.
    int open();
    // Reads up to `size` bytes. How many they are, 0 at the end of the entry, or a negative result
    // for a damaged one.
    int read(char* bytes, std::size_t size);
    // Closes the entry; one that was read whole is checked against its sum.
    int close();

  private:
    struct Inflating;

    int inflateSome(char* bytes, unsigned size);
    int leaveToMinizip();

    unzFile archive_;
    std::unique_ptr<Inflating> inflating_;
};

}  // namespace dp
