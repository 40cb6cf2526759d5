// Numbers in text files, read and written as the C library does in the C locale, whatever the desktop's
// locale is.
//
// Reading: ReadFloat handles plain decimals, which are nearly all numbers. The others go through from_chars.
//
// Writing: a float has a 24-bit mantissa, and 10^6 needs 14 bits plus a power of two. Their product is
// therefore exact in a double, and six decimals need only one rounding.

#include "Numbers.h"

#include <algorithm>
#include <array>
#include <bit>
#include <charconv>
#include <cmath>
#include <cstring>
#include <limits>
#include <system_error>

namespace gw {

namespace {

bool IsDigit(char c)
{
    return static_cast<unsigned char>(c - '0') < 10;
}

bool IsHexDigit(char c)
{
    return IsDigit(c) || (c >= 'a' && c <= 'f') || (c >= 'A' && c <= 'F');
}

bool IsBlank(char c)
{
    return c == ' ' || (c >= '\t' && c <= '\r');
}

const char* SkipBlanks(const char* text, const char* end)
{
    return std::find_if_not(text, end, IsBlank);
}

// from_chars accepts no plus sign. It is kept if a second sign follows, because such a text is not a number.
const char* SkipPlus(const char* text, const char* end)
{
    return end - text > 1 && text[0] == '+' && text[1] != '-' ? text + 1 : text;
}

int64_t ReadExponent(std::string_view text)
{
    // small enough that adding the digit count of any text cannot overflow
    constexpr int64_t kEndless = int64_t{1} << 50;
    const char* const end = text.data() + text.size();
    int64_t exponent = 0;
    if (std::from_chars(SkipPlus(text.data(), end), end, exponent).ec == std::errc::result_out_of_range)
        return text.front() == '-' ? -kEndless : kEndless;
    return std::clamp(exponent, -kEndless, kEndless);
}

// When a number is out of range, from_chars does not report on which side. The position of its first nonzero
// digit does.
bool IsHuge(std::string_view number, bool hex)
{
    const size_t mark = std::min(number.find_first_of(hex ? "pP" : "eE"), number.size());
    const std::string_view digits = number.substr(0, mark);
    const int64_t exponent = mark == number.size() ? 0 : ReadExponent(number.substr(mark + 1));
    const auto point = static_cast<int64_t>(std::min(digits.find('.'), digits.size()));
    const auto first = static_cast<int64_t>(std::min(digits.find_first_not_of("-0."), digits.size()));
    return (point - first) * (hex ? 4 : 1) + exponent > 0;
}

// from_chars expects hexadecimal digits without the prefix, but would then also accept a sign, "inf" and
// "nan".
bool StartsHex(const char* text, const char* end)
{
    if (end - text < 3 || text[0] != '0' || (text[1] | 0x20) != 'x')
        return false;
    return IsHexDigit(text[2]) || (text[2] == '.' && end - text > 3 && IsHexDigit(text[3]));
}

// from_chars also accepts two signs in an exponent, "p+-3".
const char* EndOfHex(const char* text, const char* end)
{
    constexpr std::string_view kOtherLetters = ".pP+-";
    constexpr std::string_view kTwoSigns = "+-";
    const auto belongs = [=](char c) { return IsHexDigit(c) || kOtherLetters.find(c) != kOtherLetters.npos; };
    return std::search(text, std::find_if_not(text, end, belongs), kTwoSigns.begin(), kTwoSigns.end());
}

// Reads a number in any form, without leading blanks, as strtod does. Returns its end, or null if it is not a
// number.
const char* ReadAny(const char* text, const char* end, double& value)
{
    text = SkipPlus(text, end);
    const bool negative = text != end && *text == '-';
    const bool hex = StartsHex(text + negative, end);
    const char* const first = hex ? text + negative + 2 : text;
    if (hex)
        end = EndOfHex(first, end);
    double number = 0.0;
    const auto [next, error] =
        std::from_chars(first, end, number, hex ? std::chars_format::hex : std::chars_format::general);
    if (error == std::errc::invalid_argument)
        return nullptr;
    if (error == std::errc::result_out_of_range)
    {
        const bool huge = IsHuge({first, next}, hex);
        number = huge ? std::numeric_limits<double>::infinity() : 0.0;
    }
    value = hex || error != std::errc{} ? std::copysign(number, negative ? -1.0 : 1.0) : number;
    return next;
}

// sscanf never backs up: it reads "0x" and "infi" as failures, where strtod reads 0 and infinity.
bool IsCutShort(const char* text, const char* next, const char* end, double value)
{
    if (next == end)
        return false;
    if ((*next | 0x20) == 'i')
        return std::isinf(value) && (next[-1] | 0x20) == 'f';
    const char* const first = *text == '-' || *text == '+' ? text + 1 : text;
    const bool pointFollows = end - next > 1 && next[1] == '.';
    return (*next | 0x20) == 'x' && *first == '0' && next - first == 1 && !pointFollows;
}

// Same as sscanf, narrowed to a float.
const char* ReadAnyNarrowed(const char* text, const char* end, float& value)
{
    double wide = 0.0;
    const char* const next = ReadAny(text, end, wide);
    if (!next || IsCutShort(text, next, end, wide))
        return nullptr;
    value = static_cast<float>(wide);
    return next;
}

ENumber KindOfWhole(double value, const char* next, const char* end)
{
    if (!std::isfinite(value))
        return ENumber::Unusual;
    return SkipBlanks(next, end) == end ? ENumber::Whole : ENumber::Stuck;
}

ENumber KindInRow(const char* next, const char* end)
{
    return next == end || *next == ' ' || *next == ',' || IsBlank(*next) ? ENumber::Whole : ENumber::Stuck;
}

// The numbers below 1000 as text: left-aligned for the digits before the point, padded for groups of three
// after it.
struct Triple
{
    char padded[4]; // the fourth byte pads it to a word, which copies faster than three bytes
    char plain[3];
    uint8_t length;
};

constexpr auto kTriples = [] {
    std::array<Triple, 1000> rows{};
    for (int i = 0; i < 1000; ++i)
    {
        Triple& row = rows[static_cast<size_t>(i)];
        row.length = i < 10 ? 1 : i < 100 ? 2 : 3;
        for (int k = 0, divisor = 100; k < 3; ++k, divisor /= 10)
            row.padded[k] = static_cast<char>('0' + i / divisor % 10);
        for (int k = 0; k < row.length; ++k)
            row.plain[k] = row.padded[3 - row.length + k];
    }
    return rows;
}();

// Larger numbers, infinities and NaN are rare and go through to_chars. A million times this limit is below
// 2^52.
constexpr float kPlainLimit = 4294967296.0f;
constexpr uint32_t kMillion = 1000000;

// Rounds a number below 2^52 to the nearest integer, ties to even. Adding 2^52 leaves a double no fraction
// bits.
uint64_t Rounded(double number)
{
    constexpr double kAllWhole = 4503599627370496.0;
    return std::bit_cast<uint64_t>(number + kAllWhole) - std::bit_cast<uint64_t>(kAllWhole);
}

char* WriteWhole(char* out, uint64_t number)
{
    if (number >= kTriples.size())
        return std::to_chars(out, out + kFixed6Bytes, number).ptr;
    const Triple& row = kTriples[number];
    std::memcpy(out, row.plain, 3);
    return out + row.length;
}

} // namespace

double ParseDouble(std::string_view text)
{
    ENumber kind;
    return ParseDouble(text, kind);
}

double ParseDouble(std::string_view text, ENumber& kind)
{
    const char* const end = text.data() + text.size();
    double value = 0.0;
    const char* const next = ReadAny(SkipBlanks(text.data(), end), end, value);
    kind = next ? KindOfWhole(value, next, end) : ENumber::None;
    return value;
}

bool ScanFloat(std::string_view text, float& value)
{
    ENumber kind;
    return ScanFloat(text, value, kind);
}

bool ScanFloat(std::string_view text, float& value, ENumber& kind)
{
    const char* const end = text.data() + text.size();
    const char* const next = ReadAnyNarrowed(SkipBlanks(text.data(), end), end, value);
    kind = next ? KindOfWhole(static_cast<double>(value), next, end) : ENumber::None;
    return next != nullptr;
}

int32_t ParseInt(std::string_view text)
{
    int32_t value = 0;
    ScanInt(text, value);
    return value;
}

bool ScanInt(std::string_view text, int32_t& value)
{
    const char* const end = text.data() + text.size();
    const char* const first = SkipPlus(SkipBlanks(text.data(), end), end);
    const std::errc error = std::from_chars(first, end, value).ec;
    if (error == std::errc::result_out_of_range)
        value = *first == '-' ? std::numeric_limits<int32_t>::min() : std::numeric_limits<int32_t>::max();
    return error != std::errc::invalid_argument;
}

float ReadOddFloat(const char* text, const char* end, const char*& next, ENumber& kind)
{
    float value = 0.0f;
    next = ReadAnyNarrowed(SkipBlanks(text, end), end, value);
    if (!next)
    {
        next = text;
        kind = ENumber::None;
        return 0.0f;
    }
    kind = std::isfinite(value) ? KindInRow(next, end) : ENumber::Unusual;
    return value;
}

char* WriteFixed6(char* out, float value)
{
    if (!(std::fabs(value) < kPlainLimit))
        return std::to_chars(out, out + kFixed6Bytes, static_cast<double>(value), std::chars_format::fixed, 6)
            .ptr;

    const uint64_t millionths = Rounded(static_cast<double>(std::fabs(value)) * kMillion);
    *out = '-';
    out = WriteWhole(out + std::signbit(value), millionths / kMillion);
    const auto decimals = static_cast<uint32_t>(millionths % kMillion);
    *out = '.';
    std::memcpy(out + 1, kTriples[decimals / 1000].padded, 4);
    std::memcpy(out + 4, kTriples[decimals % 1000].padded, 4);
    return out + 7;
}

char* WriteShortest(char* out, float value)
{
    return std::to_chars(out, out + kShortestBytes, value, std::chars_format::fixed).ptr;
}

char* WriteInt(char* out, int32_t value)
{
    return std::to_chars(out, out + kIntBytes, value).ptr;
}

void AppendFixed6(std::string& out, float value)
{
    char text[kFixed6Bytes];
    out.append(text, WriteFixed6(text, value));
}

void AppendFixed3(std::string& out, float value)
{
    char text[kFixed6Bytes];
    out.append(text, std::to_chars(text, std::end(text), value, std::chars_format::fixed, 3).ptr);
}

void AppendFixed(std::string& out, double value, int decimals)
{
    char text[384]; // the largest number has 309 digits
    decimals = std::clamp(decimals, 0, 17);
    char* const end = std::to_chars(text, std::end(text), value, std::chars_format::fixed, decimals).ptr;
    const bool isZero = std::all_of(text, end, [](char c) { return c == '-' || c == '0' || c == '.'; });
    out.append(isZero && *text == '-' ? text + 1 : text, end);
}

void AppendInt(std::string& out, int32_t value)
{
    char text[kIntBytes];
    out.append(text, WriteInt(text, value));
}

} // namespace gw
