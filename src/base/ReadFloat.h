#pragma once

// Reading numbers in inner loops: half of a load is spent here, so that this is inline. Nearly every number
// in a motion file is a plain decimal such as -12.345678: its digits fit 53 bits and its power of ten is
// exact in a double, so that one division gives the correctly rounded result (Clinger 1990, "How to read
// floating point numbers accurately", the fast case).
//
// One digit at a time is fast: the next number can only begin where this one ends, and the processor predicts
// the branches of such a loop, so that it works on both. (Counting digits without a branch, eight at once,
// takes longer.) Six decimals, which most programs write, are taken at once behind a branch that is predicted
// just as well.

#include "Numbers.h"

#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>

namespace gw {

namespace plain {

inline constexpr double kPowersOfTen[] = {1e0,  1e1,  1e2,  1e3,  1e4,  1e5,  1e6,  1e7,  1e8,  1e9,
                                          1e10, 1e11, 1e12, 1e13, 1e14, 1e15, 1e16, 1e17, 1e18, 1e19};
inline constexpr ptrdiff_t kMostDigits = 19; // what 64 bits always hold
inline constexpr uint64_t kExactMantissa = uint64_t{1} << 53;

/// Adds the digits at a place to a number. It may wrap; the caller counts the digits.
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

/// Adds six digits and no more. False, and the number left alone, if any other number of digits is there or
/// the text ends within eight characters.
inline bool TakeSixDigits(const char* text, const char* end, uint64_t& number)
{
    if constexpr (std::endian::native != std::endian::little)
        return false;
    if (end - text < 8)
        return false;
    uint64_t eight;
    std::memcpy(&eight, text, sizeof(eight));
    // The first character is the lowest byte. Adding 0x46 carries into the top bit of a byte from ':' on.
    const uint64_t values = eight ^ 0x3030303030303030u;
    const uint64_t notDigits = ((values + 0x7676767676767676u) | values) & 0x8080808080808080u;
    if ((notDigits & 0x0080808080808080u) != 0x0080000000000000u)
        return false;
    // Two zeros before the six digits; then pairs, fours, and all eight (known as SWAR).
    uint64_t sum = values << 16;
    sum = sum * 10 + (sum >> 8);
    sum = ((sum & 0x000000ff000000ffu) * 0x000f424000000064u +
           ((sum >> 16) & 0x000000ff000000ffu) * 0x0000271000000001u) >>
          32;
    number = number * 1'000'000 + (sum & 0xffffffffu);
    return true;
}

/// Returns the end of the number, or null if from_chars has to look.
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
    // No branch: signs come in no order.
    value = std::bit_cast<double>(std::bit_cast<uint64_t>(magnitude) | uint64_t{negative} << 63);
    return next;
}

} // namespace plain

/// A number in a row of text, read from where it starts. `text` begins at a token's first character and `end`
/// is the token's end or any later separator; `next` receives the first character that is no part of the
/// number. Narrowed from 64 bits.
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
