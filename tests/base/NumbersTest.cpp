#include "Numbers.h"
#include "ReadFloat.h"

#include <bit>
#include <cfloat>
#include <charconv>
#include <cmath>
#include <cstdio>
#include <gtest/gtest.h>
#include <iterator>
#include <limits>
#include <random>
#include <tuple>
#include <vector>

namespace gw {
namespace {

constexpr float kInfinity = std::numeric_limits<float>::infinity();
constexpr float kNan = std::numeric_limits<float>::quiet_NaN();
constexpr float kUntouched = -99.0f;

// Compares sign and bits; all NaNs are equal.
template <class T>
bool IsSame(T a, T b)
{
    return std::signbit(a) == std::signbit(b) && (a == b || (std::isnan(a) && std::isnan(b)));
}

// The text in its own buffer: the sanitizer notices one byte read too many.
struct CBlock
{
    explicit CBlock(std::string_view text) : bytes(text.begin(), text.end()) {}
    const char* End() const { return bytes.data() + bytes.size(); }
    std::string_view Text() const { return {bytes.data(), bytes.size()}; }
    std::vector<char> bytes;
};

struct CRead
{
    float value;
    size_t length;
    ENumber kind;
};

CRead ReadFront(const CBlock& block)
{
    const char* next = nullptr;
    ENumber kind = ENumber::None;
    const float value = ReadFloat(block.bytes.data(), block.End(), next, kind);
    return {value, static_cast<size_t>(next - block.bytes.data()), kind};
}

template <class F>
std::string Appended(F append, float value)
{
    std::string text;
    append(text, value);
    return text;
}

std::string Printed(float value, int decimals = 6)
{
    char text[64];
    std::snprintf(text, sizeof text, "%.*f", decimals, static_cast<double>(value));
    return text;
}

// Characters of numbers in random order, and sometimes a number in a printed form.
std::string RandomText(std::mt19937_64& random)
{
    constexpr std::string_view kLetters = "0123456789012345678901234567890.....--++eExXpPinfatyN(ab) \t,";
    char text[96] = {};
    switch (random() % 6)
    {
    case 0:
        std::snprintf(text, sizeof text, "%.*g", static_cast<int>(random() % 20 + 1),
                      std::bit_cast<double>(random()));
        return text;
    case 1:
        std::snprintf(text, sizeof text, "%a%c", std::bit_cast<double>(random()), kLetters[random() % 60]);
        return text;
    case 2:
        std::snprintf(text, sizeof text, "%.*f", static_cast<int>(random() % 12),
                      static_cast<double>(random() % 2000001) / 999.0 - 1000.0);
        return text;
    default:
        for (size_t length = random() % 16; length > 0; --length)
            text[length - 1] = kLetters[random() % kLetters.size()];
        return text;
    }
}

} // namespace

// Cases that random texts do not reach, and the kinds, which the library does not report.
TEST(Numbers, OddTextsHaveTheirValueAndTheirKind)
{
    const std::string digits = "1" + std::string(400, '0') + "e-400";
    const std::string zeros = "0." + std::string(800, '0') + "1e400";
    const struct
    {
        const char* what;
        std::string text;
        float value;
        ENumber kind;
        bool scanned; // sscanf rejects some texts of which strtod reads the beginning
    } rows[] = {
        {"plain", "-12.345678", -12.345678f, ENumber::Whole, true},
        {"negative zero", "-0.000000", -0.0f, ENumber::Whole, true},
        {"blanks around it", "\v\f\r\n\t +7 \r\n", 7.0f, ENumber::Whole, true},
        {"another number stuck to it", "0.0-7.5", 0.0f, ENumber::Stuck, true},
        {"decimal comma and more", "1,5x", 1.0f, ENumber::Stuck, true},
        {"more digits than 64 bits hold", "1.00000000000000000000001", 1.0f, ENumber::Whole, true},
        {"digits that wrap to 1", "18446744073709551617", 0x1p64f, ENumber::Whole, true},
        {"narrowed from 64 bits", "1.00000017881393432617187499", 1.0000002f, ENumber::Whole, true},
        {"hexadecimal, two signs", "0x7p+-1", 7.0f, ENumber::Stuck, true},
        {"hexadecimal of a sign", "0x-5", 0.0f, ENumber::Stuck, false},
        {"begun infinity", "infi", kInfinity, ENumber::Unusual, false},
        {"no number", "nan", kNan, ENumber::Unusual, true},
        {"too big for 64 bits", "-1e400", -kInfinity, ENumber::Unusual, true},
        {"too small for 64 bits", "-1e-400", -0.0f, ENumber::Whole, true},
        {"exponent beyond 64 bits", "1e-99999999999999999999", 0.0f, ENumber::Whole, true},
        {"exponent that 64 bits just hold", "12e9223372036854775807", kInfinity, ENumber::Unusual, true},
        {"digits outweigh it", digits, 1.0f, ENumber::Whole, true},
        {"zeros outweigh it", zeros, 0.0f, ENumber::Whole, true},
        {"nothing", "", 0.0f, ENumber::None, false},
        {"a sign only", "-", 0.0f, ENumber::None, false},
        {"a point only", "-.", 0.0f, ENumber::None, false},
        {"two signs", "+-5", 0.0f, ENumber::None, false},
        {"a word", "abc", 0.0f, ENumber::None, false},
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.what);
        const CBlock block(row.text);
        ENumber kind = ENumber::None;
        EXPECT_TRUE(IsSame(static_cast<float>(ParseDouble(block.Text(), kind)), row.value));
        EXPECT_EQ(kind, row.kind);
        float scanned = kUntouched;
        EXPECT_EQ(ScanFloat(block.Text(), scanned, kind), row.scanned);
        EXPECT_TRUE(IsSame(scanned, row.scanned ? row.value : kUntouched)) << scanned;
        EXPECT_EQ(kind, row.scanned ? row.kind : ENumber::None);
        const CRead read = ReadFront(block);
        EXPECT_TRUE(IsSame(read.value, row.scanned ? row.value : 0.0f)) << read.value;
        const bool isCutByComma = row.text.find(',') != row.text.npos;
        EXPECT_EQ(read.kind, isCutByComma ? ENumber::Whole : kind);
    }
    ENumber kind;
    EXPECT_EQ(ParseDouble("1e39", kind), 1e39);
    EXPECT_EQ(kind, ENumber::Whole);
    float big = 0.0f;
    EXPECT_TRUE(ScanFloat("1e39", big, kind));
    EXPECT_EQ(kind, ENumber::Unusual);
}

TEST(Numbers, RandomTextsReadAsTheLibraryReadsThem)
{
    if (float value = 0.0f; std::sscanf("0xp", "%f", &value) == 1)
        GTEST_SKIP() << "this C library reads odd texts in its own way";
    std::mt19937_64 random(1);
    for (int i = 0; i < 200000; ++i)
    {
        const std::string text = RandomText(random);
        const CBlock block(text);
        char* end = nullptr;
        const double expected = std::strtod(text.c_str(), &end);
        ASSERT_TRUE(IsSame(ParseDouble(block.Text()), expected)) << text;

        float byLibrary = 0.0f;
        const bool isNumber = std::sscanf(text.c_str(), "%f", &byLibrary) == 1;
        float scanned = kUntouched;
        ASSERT_EQ(ScanFloat(block.Text(), scanned), isNumber) << text;
        const CRead read = ReadFront(block);
        ASSERT_EQ(read.length, isNumber ? static_cast<size_t>(end - text.c_str()) : 0u) << text;
        if (isNumber)
        {
            ASSERT_TRUE(IsSame(scanned, static_cast<float>(expected))) << text;
            ASSERT_TRUE(IsSame(read.value, scanned)) << text;
        }
    }
}

TEST(Numbers, IntegersReadAsTheLibraryReadsThemAndStopAtTheEnds)
{
    const std::tuple<const char*, bool, int32_t> rows[] = {
        {"12", true, 12},
        {" \t\r\n+12x", true, 12},
        {"-12.9", true, -12},
        {"0x10", true, 0},
        {"2147483647", true, INT32_MAX},
        {"2147483648", true, INT32_MAX},
        {"-99999999999", true, INT32_MIN},
        {"+99999999999", true, INT32_MAX},
        {"+-12", false, 0},
        {"-", false, 0},
        {"", false, 0},
        {"x", false, 0},
    };
    for (const auto& [words, scanned, held] : rows)
    {
        SCOPED_TRACE(words);
        const CBlock block(words);
        int32_t value = -5;
        EXPECT_EQ(ScanInt(block.Text(), value), scanned);
        EXPECT_EQ(value, scanned ? held : -5);
        EXPECT_EQ(ParseInt(block.Text()), held);
        char text[kIntBytes];
        EXPECT_EQ(std::string(text, WriteInt(text, held)), std::to_string(held));
    }
}

TEST(Numbers, FloatsPrintAsTheLibraryPrintsThem)
{
    for (const float value : {0.0f, kInfinity, FLT_MAX, FLT_TRUE_MIN, 0x1p40f, 0x1p24f, 5e-7f, 1000.0f, 1e6f})
    {
        for (const float v : {value, -value, std::nextafter(value, 0.0f), std::nextafter(value, kInfinity)})
        {
            EXPECT_EQ(Appended(AppendFixed6, v), Printed(v));
            EXPECT_EQ(Appended(AppendFixed3, v), Printed(v, 3));
        }
    }
    EXPECT_EQ(Appended(AppendFixed6, kNan) + Appended(AppendFixed3, -kNan), "nan-nan")
        << "not as all libraries";
    std::mt19937_64 random(2);
    for (int i = 0; i < 1000000; ++i)
    {
        auto bits = static_cast<uint32_t>(random());
        if (i % 2) // exponents with digits on both sides of the point
            bits = (bits & 0x807fffff) | static_cast<uint32_t>(100 + random() % 70) << 23;
        if (i % 8 == 0) // few bits: exactly between two decimals
            bits &= ~0u << random() % 23;
        const auto value = std::bit_cast<float>(bits);
        char text[kFixed6Bytes];
        char expected[64]; // not by printf, which takes five times as long
        const auto [end, error] = std::to_chars(expected, std::end(expected), static_cast<double>(value),
                                                std::chars_format::fixed, 6);
        ASSERT_EQ(std::string_view(text, WriteFixed6(text, value)), std::string_view(expected, end));
    }
}

} // namespace gw
