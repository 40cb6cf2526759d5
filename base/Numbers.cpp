// Numbers of text files, read and written as the C library does in the C locale, whatever the locale of the
// desktop.
//
// Reading. Nearly every number in a motion file is a plain decimal such as -12.345678: its digits fit 53 bits
// and its power of ten is exact in a double, so that one division gives the correctly rounded result (Clinger
// 1990, "How to read floating point numbers accurately", the fast case). All others go through from_chars.
//
// Writing. A float is m * 2^e with m below 2^24, so that m * 10^6 fits 44 bits: six decimals are one shift
// with the cut bits at hand for rounding, which is exact.

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

constexpr double kPowersOfTen[] = {1e0,  1e1,  1e2,  1e3,  1e4,  1e5,  1e6,  1e7,  1e8,  1e9,
                                   1e10, 1e11, 1e12, 1e13, 1e14, 1e15, 1e16, 1e17, 1e18, 1e19};
constexpr ptrdiff_t kPlainDigits = 19; // what 64 bits always hold
constexpr uint64_t kExactMantissa = uint64_t{1} << 53;

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

// from_chars takes no plus sign. It stays where a second sign follows, which makes the text no number.
const char* SkipPlus(const char* text, const char* end)
{
    return end - text > 1 && text[0] == '+' && text[1] != '-' ? text + 1 : text;
}

// Adds the digits at a place to a number. It may wrap; the caller counts the digits.
inline const char* TakeDigits(const char* text, const char* end, uint64_t& number)
{
    for (; text != end; ++text)
    {
        const unsigned digit = static_cast<unsigned char>(*text) - unsigned{'0'};
        if (digit > 9)
            break;
        number = number * 10 + digit;
    }
    return text;
}

// The fast case. Answers the end of the number, or null where from_chars has to look. One digit at a time is
// the fastest: the next number can only begin where this one ends, and the processor foresees the branches of
// this loop, so that it works on both. (Eight digits at once without a branch: 17 ns a number; this: 10.)
inline const char* ReadPlain(const char* text, const char* end, double& value)
{
    const bool negative = text != end && *text == '-';
    const char* const first = text + negative;
    uint64_t number = 0;
    const char* next = TakeDigits(first, end, number);
    ptrdiff_t count = next - first;
    ptrdiff_t decimals = 0;
    if (next != end && *next == '.')
    {
        const char* const point = next + 1;
        next = TakeDigits(point, end, number);
        decimals = next - point;
        count += decimals;
    }
    if (count == 0 || count > kPlainDigits || number > kExactMantissa)
        return nullptr;
    if (next != end && ((*next | 0x20) == 'e' || (*next | 0x20) == 'x'))
        return nullptr;
    const double magnitude = static_cast<double>(static_cast<int64_t>(number)) / kPowersOfTen[decimals];
    // No branch: signs come in no order.
    value = std::bit_cast<double>(std::bit_cast<uint64_t>(magnitude) | uint64_t{negative} << 63);
    return next;
}

int64_t ReadExponent(std::string_view text)
{
    constexpr int64_t kEndless = int64_t{1} << 50; // so that the digits of any text can be added
    const char* const end = text.data() + text.size();
    int64_t exponent = 0;
    if (std::from_chars(SkipPlus(text.data(), end), end, exponent).ec == std::errc::result_out_of_range)
        return text.front() == '-' ? -kEndless : kEndless;
    return std::clamp(exponent, -kEndless, kEndless);
}

// from_chars does not say on which side a number leaves the range: the place of its first digit not 0 does.
bool IsHuge(std::string_view number, bool hex)
{
    const size_t mark = std::min(number.find_first_of(hex ? "pP" : "eE"), number.size());
    const std::string_view digits = number.substr(0, mark);
    const int64_t exponent = mark == number.size() ? 0 : ReadExponent(number.substr(mark + 1));
    const auto point = static_cast<int64_t>(std::min(digits.find('.'), digits.size()));
    const auto first = static_cast<int64_t>(std::min(digits.find_first_not_of("-0."), digits.size()));
    return (point - first) * (hex ? 4 : 1) + exponent > 0;
}

// from_chars wants hexadecimal digits without their prefix; there it would also take a sign, "inf" and "nan".
bool StartsHex(const char* text, const char* end)
{
    if (end - text < 3 || text[0] != '0' || (text[1] | 0x20) != 'x')
        return false;
    return IsHexDigit(text[2]) || (text[2] == '.' && end - text > 3 && IsHexDigit(text[3]));
}

// It also takes two signs in an exponent, "p+-3".
const char* EndOfHex(const char* text, const char* end)
{
    constexpr std::string_view kOtherLetters = ".pP+-";
    constexpr std::string_view kTwoSigns = "+-";
    const auto belongs = [=](char c) { return IsHexDigit(c) || kOtherLetters.find(c) != kOtherLetters.npos; };
    return std::search(text, std::find_if_not(text, end, belongs), kTwoSigns.begin(), kTwoSigns.end());
}

// A number of any form without blanks before it, as strtod reads it. Answers its end, or null for no number.
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

// sscanf does not go back once it has begun: "0x" and "infi" are no numbers to it, where strtod reads 0 and
// infinity.
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

// The same as sscanf reads it, narrowed.
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

// Apart from the fast case, whose registers it would take.
[[gnu::noinline]] float ReadOddFloat(const char* text, const char* end, const char*& next, ENumber& kind)
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

// The numbers below 1000 as text, from the left, for what stands before the point and in threes behind it.
struct CTriple
{
    char padded[3];
    char plain[3];
    uint8_t length;
};

constexpr auto kTriples = [] {
    std::array<CTriple, 1000> rows{};
    for (int i = 0; i < 1000; ++i)
    {
        CTriple& row = rows[static_cast<size_t>(i)];
        row.length = i < 10 ? 1 : i < 100 ? 2 : 3;
        for (int k = 0, divisor = 100; k < 3; ++k, divisor /= 10)
            row.padded[k] = static_cast<char>('0' + i / divisor % 10);
        for (int k = 0; k < row.length; ++k)
            row.plain[k] = row.padded[3 - row.length + k];
    }
    return rows;
}();

// The bits of a 32-bit float.
constexpr int kMantissaBits = 23;
constexpr int kExponentBias = 127;
constexpr uint32_t kMantissaMask = (1u << kMantissaBits) - 1;
// Numbers of 2^40 and above, infinities and NaN are rare and go through to_chars.
constexpr int kIntegerLimit = 40;
constexpr uint64_t kMillion = 1000000;

// n / 2^shift, rounded to nearest, ties to even, for n below 2^44.
uint64_t RoundedShift(uint64_t n, int shift)
{
    if (shift > 45)
        return 0;
    const uint64_t quotient = n >> shift;
    const uint64_t rest = n - (quotient << shift);
    const uint64_t half = uint64_t{1} << (shift - 1);
    return quotient + (rest > half || (rest == half && (quotient & 1)));
}

char* WriteWhole(char* out, uint64_t number)
{
    if (number >= kTriples.size())
        return std::to_chars(out, out + kFixed6Bytes, number).ptr;
    const CTriple& row = kTriples[number];
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

float ReadFloat(const char* text, const char* end, const char*& next, ENumber& kind)
{
    double plain;
    const char* const plainEnd = ReadPlain(text, end, plain);
    if (!plainEnd)
        return ReadOddFloat(text, end, next, kind);
    next = plainEnd;
    kind = KindInRow(plainEnd, end);
    return static_cast<float>(plain);
}

char* WriteFixed6(char* out, float value)
{
    const auto bits = std::bit_cast<uint32_t>(value);
    const int biased = static_cast<int>(bits >> kMantissaBits & 0xff);
    if (biased >= kExponentBias + kIntegerLimit)
        return std::to_chars(out, out + kFixed6Bytes, static_cast<double>(value), std::chars_format::fixed, 6)
            .ptr;

    const uint32_t fraction = bits & kMantissaMask;
    const uint64_t mantissa = biased ? fraction | 1u << kMantissaBits : fraction;
    const int exponent = std::max(biased, 1) - kExponentBias - kMantissaBits;
    const uint64_t millionths =
        exponent >= 0 ? mantissa * kMillion << exponent : RoundedShift(mantissa * kMillion, -exponent);
    *out = '-';
    out = WriteWhole(out + (bits >> 31), millionths / kMillion);
    const uint64_t decimals = millionths % kMillion;
    *out = '.';
    std::memcpy(out + 1, kTriples[decimals / 1000].padded, 3);
    std::memcpy(out + 4, kTriples[decimals % 1000].padded, 3);
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
