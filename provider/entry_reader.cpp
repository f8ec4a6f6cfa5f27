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

namespace {

constexpr std::size_t kLargest = std::numeric_limits<int>::max();  // of what minizip gives at once

}  // namespace

#ifdef DPXLSX_ISAL

// An entry that is open, and the part of it that is on its way. What is not deflated, or not sound
// to ISA-L, is left to minizip.
struct EntryReader::Inflating {
    std::array<std::uint8_t, std::size_t{32} << 10> compressed;
    inflate_state state;
    bool leftToMinizip = false;
    std::uint64_t size = 0;  // bytes that the entry claims to hold
    std::uint64_t rest = 0;  // of them, those that have not been read
    std::uint32_t sum = 0;
    std::uint32_t expectedSum = 0;
};

EntryReader::EntryReader(unzFile archive)
    : archive_(archive), inflating_(std::make_unique<Inflating>()) {}

int EntryReader::open() {
    unz_file_info64 info{};
    int result = unzGetCurrentFileInfo64(archive_, &info, nullptr, 0, nullptr, 0, nullptr, 0);
    if (result != UNZ_OK) return result;
    inflating_->leftToMinizip = info.compression_method != Z_DEFLATED;
    if (inflating_->leftToMinizip) return unzOpenCurrentFile(archive_);
    int method = 0;
    int level = 0;
    constexpr int kRaw = 1;
    result = unzOpenCurrentFile2(archive_, &method, &level, kRaw);
    if (result != UNZ_OK) return result;
    inflating_->size = inflating_->rest = info.uncompressed_size;
    inflating_->sum = 0;
    inflating_->expectedSum = static_cast<std::uint32_t>(info.crc);
    isal_inflate_init(&inflating_->state);
    return UNZ_OK;
}

int EntryReader::read(char* bytes, std::size_t size) {
    Inflating& entry = *inflating_;
    const auto most = static_cast<unsigned>(std::min(size, kLargest));
    if (!entry.leftToMinizip) {
        const auto wanted = static_cast<unsigned>(std::min<std::uint64_t>(most, entry.rest));
        if (const int count = inflateSome(bytes, wanted); count >= 0) {
            entry.rest -= static_cast<unsigned>(count);
            entry.sum = crc32_gzip_refl(entry.sum, reinterpret_cast<const std::uint8_t*>(bytes),
                                        static_cast<std::uint64_t>(count));
            return count;
        }
        if (const int result = leaveToMinizip(); result != UNZ_OK) return result;
    }
    return unzReadCurrentFile(archive_, bytes, most);
}

int EntryReader::close() {
    const int result = unzCloseCurrentFile(archive_);
    if (inflating_->leftToMinizip) return result;
    const bool wrong = inflating_->rest == 0 && inflating_->sum != inflating_->expectedSum;
    return wrong ? UNZ_CRCERROR : result;
}

// From the byte on that comes next: minizip has several errors for what ISA-L calls damaged, and
// none for damage behind the bytes that the entry claims to hold, to which ISA-L looks ahead.
int EntryReader::leaveToMinizip() {
    inflating_->leftToMinizip = true;
    unzCloseCurrentFile(archive_);
    if (const int result = unzOpenCurrentFile(archive_); result != UNZ_OK) return result;
    auto& passed = inflating_->compressed;
    for (std::uint64_t rest = inflating_->size - inflating_->rest; rest > 0;) {
        const auto size = static_cast<unsigned>(std::min<std::uint64_t>(rest, passed.size()));
        const int count = unzReadCurrentFile(archive_, passed.data(), size);
        if (count <= 0) return count < 0 ? count : Z_DATA_ERROR;
        rest -= static_cast<unsigned>(count);
    }
    return UNZ_OK;
}

// A negative result for anything that ISA-L does not inflate.
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
    return unzReadCurrentFile(archive_, bytes, static_cast<unsigned>(std::min(size, kLargest)));
}

int EntryReader::close() { return unzCloseCurrentFile(archive_); }

#endif

EntryReader::~EntryReader() = default;

}  // namespace dp
