#include "testkit/zip_writer.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <stdexcept>

namespace testkit {

namespace {

constexpr std::size_t kHeader = 30;  // bytes in front of an entry's name

void put(std::string& bytes, std::uint64_t value, int size) {
    for (int i = 0; i < size; ++i) bytes += static_cast<char>(value >> (8 * i) & 0xFF);
}

const Bytef* bytesOf(std::string_view text) { return reinterpret_cast<const Bytef*>(text.data()); }

}  // namespace

void ZipWriter::add(const Entry& entry) {
    begin(entry.name, entry.deflated);
    write(entry.content);
    if (entry.claimedMethod) written_.method = entry.claimedMethod;
    const std::uint32_t sum = entry.claimedSum ? entry.claimedSum : written_.sum;
    end(entry.wrongSum ? ~sum : sum, entry.claimedSize ? entry.claimedSize : written_.size);
}

void ZipWriter::begin(const std::string& name, bool deflated) {
    const unsigned method = deflated ? Z_DEFLATED : 0;
    written_ = {name, deflated, method, local_.size(), local_.size() + kHeader + name.size()};
    local_.resize(written_.content);  // the header comes when the sizes are known
    if (deflated && deflateInit2(&written_.stream, Z_BEST_SPEED, Z_DEFLATED, -MAX_WBITS, 8,
                                 Z_DEFAULT_STRATEGY) != Z_OK)
        throw std::runtime_error("zlib does not start");
}

void ZipWriter::write(std::string_view piece) {
    written_.sum = static_cast<std::uint32_t>(
        crc32(written_.sum, bytesOf(piece), static_cast<uInt>(piece.size())));
    written_.size += piece.size();
    if (written_.deflated)
        deflatePiece(piece, Z_NO_FLUSH);
    else
        local_ += piece;
}

void ZipWriter::deflatePiece(std::string_view piece, int flush) {
    std::array<char, 1 << 14> packed;
    z_stream& stream = written_.stream;
    stream.next_in = const_cast<Bytef*>(bytesOf(piece));
    stream.avail_in = static_cast<uInt>(piece.size());
    do {
        stream.next_out = reinterpret_cast<Bytef*>(packed.data());
        stream.avail_out = packed.size();
        deflate(&stream, flush);
        local_.append(packed.data(), packed.size() - stream.avail_out);
    } while (stream.avail_out == 0);
}

void ZipWriter::end(std::uint32_t sum, std::size_t size) {
    if (written_.deflated) {
        deflatePiece({}, Z_FINISH);
        deflateEnd(&written_.stream);
    }
    std::string common;
    put(common, 20, 2);  // version needed
    put(common, 0, 2);   // flags
    put(common, written_.method, 2);
    put(common, 0x21 << 16, 4);  // 1980-01-01, the first date of the format
    put(common, sum, 4);
    put(common, local_.size() - written_.content, 4);
    put(common, size, 4);
    put(common, written_.name.size(), 2);
    put(common, 0, 2);  // extra field

    put(directory_, 0x02014b50, 4);
    put(directory_, 20, 2);  // version made by
    directory_ += common;
    put(directory_, 0, 6);  // length of the comment, disk, attributes inside
    put(directory_, 0, 4);  // attributes outside
    put(directory_, written_.start, 4);
    directory_ += written_.name;

    std::string header;
    put(header, 0x04034b50, 4);
    local_.replace(written_.start, written_.content - written_.start,
                   header + common + written_.name);
    ++entries_;
}

std::string ZipWriter::finished() const {
    std::string archive = local_ + directory_;
    put(archive, 0x06054b50, 4);
    put(archive, 0, 4);
    const unsigned entries = std::min(entries_, 0xFFFFU);  // saturates
    put(archive, entries, 2);
    put(archive, entries, 2);
    put(archive, directory_.size(), 4);
    put(archive, local_.size(), 4);
    put(archive, 0, 2);
    return archive;
}

}  // namespace testkit
