#include "dpxlsx/store/number_recognition.h"

#include <bit>
#include <cstdint>
#include <optional>
#include <random>
#include <utility>

#include "tests/naive_columns.h"

namespace dp {
namespace {

using naive::numberIn;

// The bits of a number, or none.
std::optional<std::uint64_t> bits(std::optional<double> value) {
    return value ? std::optional(std::bit_cast<std::uint64_t>(*value)) : std::nullopt;
}

std::optional<std::uint64_t> recognised(const std::string& text, char decimal) {
    double value = 0;
    const bool found = IsNumber(text, decimal, &value);
    EXPECT_TRUE(found || value == ExcelDataProviderBase::GetMissingValue()) << text;
    return bits(found ? std::optional(value) : std::nullopt);
}

TEST(NumberRecognition, JudgesEveryShortTextAsTheRegularExpressionDoes) {
    const std::string alphabet = "1+-.,E x";
    for (std::size_t length = 0, texts = 1; length <= 5; ++length, texts *= alphabet.size())
        for (std::size_t number = 0; number < texts; ++number) {
            std::string text;
            for (std::size_t i = 0, rest = number; i < length; ++i, rest /= alphabet.size())
                text += alphabet[rest % alphabet.size()];
            for (const char decimal : {'.', ','})
                ASSERT_EQ(recognised(text, decimal), bits(numberIn(text, decimal))) << text;
        }
}

TEST(NumberRecognition, ReadsLongTextsToTheLastBit) {
    std::mt19937 random(3);
    for (int i = 0; i < 3000; ++i) {
        std::string text;
        for (auto digits = 1 + random() % 40, point = random() % 30; digits-- > 0;)
            (text += static_cast<char>('0' + random() % 10)) += digits == point ? "." : "";
        if (i % 2) text += (i % 4 == 1 ? "e-" : "D+") + std::to_string(random() % 340);
        ASSERT_EQ(recognised(text, '.'), bits(numberIn(text, '.'))) << text;
    }
}

TEST(NumberRecognition, DecidesTheOddTexts) {
    const std::pair<const char*, double> numbers[] = {
        {"  (1,5) ", -1.5}, {"-0", 0.0},        {"2D4", 2e4},  {"2d-1", 0.2}, {"1e-999", 0.0},
        {"-1e-9999", 0.0},  {"5e-324", 5e-324}, {"-,5", -0.5}, {"12,", 12},   {"\t12\r\n", 12}};
    for (const auto& [text, value] : numbers) EXPECT_EQ(recognised(text, ','), bits(value)) << text;
    const std::string others[] = {"(-5)", "( 1)",  "()",   "(",   "(12", "1e999",    "-1e999",
                                  "+,5",  "1.000", "0x1A", "inf", "nan", "12\u00A0", std::string("12\0", 3)};
    for (const std::string& text : others) EXPECT_EQ(recognised(text, ','), std::nullopt) << text;
    for (const std::size_t zeros : {308U, 309U})
        EXPECT_EQ(recognised("1" + std::string(zeros, '0'), '.').has_value(), zeros == 308);
}

}  // namespace
}  // namespace dp
