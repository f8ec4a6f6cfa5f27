#include "dpxlsx/provider/entry_reader.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <limits>

#ifdef DPXLSX_ISAL
#include <isa-l/crc.h>
#include <isa-l/igzip_lib.h>
#endif

namespace dp {

#ifdef DPXLSX_ISAL

// An entry that is open, and the part of it that is on its way.
struct EntryReader::Inflating {
    std::array<std::uint8_t, std::size_t{32} << 10> compressed;
    inflate_state state;
    bool stored = false;
    std::uint64_t rest = 0;  // bytes that the entry still claims to hold
    std::uint32_t sum = 0;
    std::uint32_t expectedSum = 0;
};

EntryReader::EntryReader(unzFile archive)
    : archive_(archive), inflating_(std::make_unique<Inflating>()) {}

int EntryReader::open() {
    unz_file_info64 info{};
    int result = unzGetCurrentFileInfo64(archive_, &info, nullptr, 0, nullptr, 0, nullptr, 0);
    if (result != UNZ_OK) return result;
    int method = 0;
    int level = 0;
    constexpr int kRaw = 1;
    result = unzOpenCurrentFile2(archive_, &method, &level, kRaw);
    if (result != UNZ_OK) return result;
    inflating_->stored = method == 0;
    inflating_->rest = info.uncompressed_size;
    inflating_->sum = 0;
    inflating_->expectedSum = static_cast<std::uint32_t>(info.crc);
    isal_inflate_init(&inflating_->state);
    return UNZ_OK;
}

int EntryReader::read(char* bytes, std::size_t size) {
    Inflating& entry = *inflating_;
    constexpr std::size_t kLargest = std::numeric_limits<int>::max();
    const auto wanted =
        static_cast<unsigned>(std::min<std::uint64_t>({size, entry.rest, kLargest}));
    int count = 0;
    if (entry.stored) {
        if (wanted > 0) count = unzReadCurrentFile(archive_, bytes, wanted);
    } else {
        count = inflateSome(bytes, wanted);
    }
    if (count <= 0) return count;
    entry.rest -= static_cast<unsigned>(count);
    entry.sum = crc32_gzip_refl(entry.sum, reinterpret_cast<const std::uint8_t*>(bytes),
                                static_cast<std::uint64_t>(count));
    return count;
}

int EntryReader::close() {
    const int result = unzCloseCurrentFile(archive_);
    const bool wrong = inflating_->rest == 0 && inflating_->sum != inflating_->expectedSum;
    return wrong ? UNZ_CRCERROR : result;
}

int EntryReader::inflateSome(char* bytes, unsigned size) {
    inflate_state& state = inflating_->state;
    state.next_out = reinterpret_cast<std::uint8_t*>(bytes);
    state.avail_out = size;
    while (state.avail_out > 0 && state.block_state != ISAL_BLOCK_FINISH) {
        if (state.avail_in == 0) {
            auto& compressed = inflating_->compressed;
            const int count = unzReadCurrentFile(archive_, compressed.data(),
                                                 static_cast<unsigned>(compressed.size()));
            if (count < 0) return count;
            state.next_in = compressed.data();
            state.avail_in = static_cast<std::uint32_t>(count);
        }
        const bool ended = state.avail_in == 0;
        const std::uint32_t room = state.avail_out;
        if (isal_inflate(&state) != ISAL_DECOMP_OK) return Z_DATA_ERROR;
        if (ended && state.avail_out == room && state.block_state != ISAL_BLOCK_FINISH)
            return Z_BUF_ERROR;  // the entry is cut short
    }
    return static_cast<int>(size - state.avail_out);
}

#else

struct EntryReader::Inflating {};

EntryReader::EntryReader(unzFile archive) : archive_(archive) {}

int EntryReader::open() { return unzOpenCurrentFile(archive_); }

int EntryReader::read(char* bytes, std::size_t size) {
    constexpr std::size_t kLargest = std::numeric_limits<int>::max();
    return unzReadCurrentFile(archive_, bytes, static_cast<unsigned>(std::min(size, kLargest)));
}

int EntryReader::close() { return unzCloseCurrentFile(archive_); }

#endif

EntryReader::~EntryReader() = default;

}  // namespace dp
