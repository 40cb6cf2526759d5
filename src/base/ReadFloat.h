#pragma once

// Reads numbers in inner loops. Half of the time of a load is spent here, so this is inline. Nearly every
// number in a motion file is a plain decimal such as -12.345678: its digits fit into 53 bits and its power of
// ten is exact in a double, so one division gives the correctly rounded result (Clinger 1990, "How to read
// floating point numbers accurately", the fast case).
//
// Reading one digit at a time is fast: the next number starts only where this one ends, and branch prediction
// lets the processor work on both. (Counting digits without branches, eight at a time, is slower.) Six
// decimals, which most programs write, are read in one step behind a branch that predicts just as well.

#include "Numbers.h"

#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>

namespace gw {

namespace plain {

inline constexpr double kPowersOfTen[] = {1e0,  1e1,  1e2,  1e3,  1e4,  1e5,  1e6,  1e7,  1e8,  1e9,
                                          1e10, 1e11, 1e12, 1e13, 1e14, 1e15, 1e16, 1e17, 1e18, 1e19};
inline constexpr ptrdiff_t kMostDigits = 19; // always fit into 64 bits
inline constexpr uint64_t kExactMantissa = uint64_t{1} << 53;

/// Appends the digits at `text` to a number, which may wrap: the caller counts the digits.
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

/// Appends exactly six digits. Returns false and leaves the number unchanged if there are more or fewer
/// digits or if fewer than eight characters of text are left.
inline bool TakeSixDigits(const char* text, const char* end, uint64_t& number)
{
    if constexpr (std::endian::native != std::endian::little)
        return false;
    if (end - text < 8)
        return false;
    uint64_t eight;
    std::memcpy(&eight, text, sizeof(eight));
    // The first character is the lowest byte. Adding 0x46 sets the top bit of every byte from ':' on.
    const uint64_t values = eight ^ 0x3030303030303030u;
    const uint64_t notDigits = ((values + 0x7676767676767676u) | values) & 0x8080808080808080u;
    if ((notDigits & 0x0080808080808080u) != 0x0080000000000000u)
        return false;
    // Two zeros before the six digits, then combine pairs, fours, and all eight (SWAR).
    uint64_t sum = values << 16;
    sum = sum * 10 + (sum >> 8);
    sum = ((sum & 0x000000ff000000ffu) * 0x000f424000000064u +
           ((sum >> 16) & 0x000000ff000000ffu) * 0x0000271000000001u) >>
          32;
    number = number * 1'000'000 + (sum & 0xffffffffu);
    return true;
}

/// Returns the end of the number, or null if from_chars has to read it.
inline const char* Read(const char* text, const char* end, double& value)
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
        next = TakeSixDigits(point, end, number) ? point + 6 : TakeDigits(point, end, number);
        decimals = next - point;
        count += decimals;
    }
    if (count == 0 || count > kMostDigits || number > kExactMantissa)
        return nullptr;
    if (next != end && ((*next | 0x20) == 'e' || (*next | 0x20) == 'x'))
        return nullptr;
    const double magnitude = static_cast<double>(static_cast<int64_t>(number)) / kPowersOfTen[decimals];
    // Without a branch: signs are unpredictable.
    value = std::bit_cast<double>(std::bit_cast<uint64_t>(magnitude) | uint64_t{negative} << 63);
    return next;
}

} // namespace plain

/// Reads a number in a row of text. `text` is the first character of a token, `end` is the token's end or any
/// later separator. `next` receives the first character after the number. Narrowed from 64 bits.
inline float ReadFloat(const char* text, const char* end, const char*& next, ENumber& kind)
{
    double value;
    const char* const numberEnd = plain::Read(text, end, value);
    if (!numberEnd)
        return ReadOddFloat(text, end, next, kind);
    next = numberEnd;
    const bool ends = next == end || *next == ' ' || *next == ',' || (*next >= '\t' && *next <= '\r');
    kind = ends ? ENumber::Whole : ENumber::Stuck;
    return static_cast<float>(value);
}

} // namespace gw
