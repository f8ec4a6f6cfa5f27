#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <iterator>
#include <limits>
#include <string>
#include <string_view>

namespace fuzz {

// Takes values from the front of an input. An input that is used up gives zeros and empty texts.
class Input {
  public:
    Input(const std::uint8_t* data, std::size_t size)
        : rest_(reinterpret_cast<const char*>(data), size) {}

    bool empty() const { return rest_.empty(); }

    unsigned byte() {
        if (rest_.empty()) return 0;
        const auto value = static_cast<unsigned char>(rest_.front());
        rest_.remove_prefix(1);
        return value;
    }
    // Two bytes, the low one first.
    unsigned word() {
        const unsigned low = byte();
        return low | byte() << 8;
    }
    bool flag() { return (byte() & 1) != 0; }

    std::string take(std::size_t size) {
        std::string text(rest_.substr(0, size));
        rest_.remove_prefix(text.size());
        return text;
    }
    // A byte with the length of the text, then the text.
    std::string text() { return take(byte()); }
    std::string rest() { return take(rest_.size()); }

    // One of the boundary numbers, or any eight bytes.
    double number() {
        using Limits = std::numeric_limits<double>;
        constexpr double kEdges[] = {0,
                                     1,
                                     -1,
                                     0.5,
                                     60,
                                     61,
                                     25569,
                                     2958466,
                                     1e15,
                                     1.001e18,
                                     -1.001e18,
                                     1.23456e30,
                                     1e300,
                                     -1e-300,
                                     Limits::max(),
                                     Limits::denorm_min(),
                                     Limits::infinity(),
                                     -Limits::infinity(),
                                     Limits::quiet_NaN()};
        const unsigned which = byte();
        if (which < std::size(kEdges)) return kEdges[which];
        double value = which;
        const std::string bytes = take(sizeof value);
        if (bytes.size() == sizeof value) std::memcpy(&value, bytes.data(), sizeof value);
        return value;
    }

    // One of the boundary numbers of rows, columns and keys, or a small one.
    unsigned index() {
        constexpr unsigned kEdges[] = {0,          1,          16383,     16384,      65535,
                                       65536,      1048575,    1048576,   0x7FFFFFFE, 0x7FFFFFFF,
                                       0x80000000, 0xFFFFFFFE, 0xFFFFFFFF};
        const unsigned which = byte();
        constexpr unsigned kFirst = 256 - static_cast<unsigned>(std::size(kEdges));
        return which >= kFirst ? kEdges[which - kFirst] : which;
    }

  private:
    std::string_view rest_;
};

}  // namespace fuzz
