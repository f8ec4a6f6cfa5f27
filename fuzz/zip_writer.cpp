#include "fuzz/zip_writer.h"

#include <zlib.h>

#include <algorithm>

namespace fuzz {

namespace {

void put(std::string& bytes, std::uint64_t value, int size) {
    for (int i = 0; i < size; ++i) bytes += static_cast<char>(value >> (8 * i) & 0xFF);
}

const Bytef* bytesOf(const std::string& text) {
    return reinterpret_cast<const Bytef*>(text.data());
}

// The content as raw deflate stream.
std::string deflated(const std::string& content) {
    z_stream stream{};
    deflateInit2(&stream, Z_BEST_SPEED, Z_DEFLATED, -MAX_WBITS, 8, Z_DEFAULT_STRATEGY);
    std::string packed(deflateBound(&stream, content.size()), '\0');
    stream.next_in = const_cast<Bytef*>(bytesOf(content));
    stream.avail_in = static_cast<uInt>(content.size());
    stream.next_out = reinterpret_cast<Bytef*>(packed.data());
    stream.avail_out = static_cast<uInt>(packed.size());
    deflate(&stream, Z_FINISH);
    packed.resize(stream.total_out);
    deflateEnd(&stream);
    return packed;
}

}  // namespace

void ZipWriter::add(const Entry& entry) {
    const std::string packed = entry.deflated ? deflated(entry.content) : entry.content;
    const uLong sum = crc32(0, bytesOf(entry.content), static_cast<uInt>(entry.content.size()));
    const std::size_t size = entry.claimedSize ? entry.claimedSize : entry.content.size();
    std::string common;
    put(common, 20, 2);  // version needed
    put(common, 0, 2);   // flags
    put(common, entry.deflated ? Z_DEFLATED : 0, 2);
    put(common, 0x21 << 16, 4);  // 1980-01-01, the first date of the format
    put(common, entry.wrongSum ? ~sum : sum, 4);
    put(common, packed.size(), 4);
    put(common, size, 4);
    put(common, entry.name.size(), 2);
    put(common, 0, 2);  // extra field

    put(directory_, 0x02014b50, 4);
    put(directory_, 20, 2);  // version made by
    directory_ += common;
    put(directory_, 0, 6);  // length of the comment, disk, attributes inside
    put(directory_, 0, 4);  // attributes outside
    put(directory_, local_.size(), 4);
    directory_ += entry.name;

    put(local_, 0x04034b50, 4);
    local_ += common + entry.name + packed;
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

}  // namespace fuzz
