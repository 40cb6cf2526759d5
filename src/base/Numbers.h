#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace gw {

/// What a text holds where a number should stand.
enum class ENumber : uint8_t
{
    None,    ///< no number at all: "abc", "", "-"
    Whole,   ///< the whole text is one finite number
    Stuck,   ///< a finite number with something stuck to it: "0.0-7.5"
    Unusual, ///< "nan", "inf", or a number too big for the type
};

/// The result of atof in the C locale, whatever the locale of the desktop: leading blanks and one sign are
/// skipped, what follows the number is ignored, no number is 0.
double ParseDouble(std::string_view text);
/// The same with a verdict, for readers that warn about or refuse odd numbers.
double ParseDouble(std::string_view text, ENumber& kind);
/// The result of sscanf with "%f" in the C locale; false, and value left alone, where no number stands.
/// Parsed as 64 bits and narrowed.
bool ScanFloat(std::string_view text, float& value);
bool ScanFloat(std::string_view text, float& value, ENumber& kind);
/// The result of atoi: leading blanks, a sign, digits; 0 for no digits. Beyond 32 bits it is the nearest end.
int32_t ParseInt(std::string_view text);
/// The result of sscanf with "%d"; false, and value left alone, where no digits stand.
bool ScanInt(std::string_view text, int32_t& value);

/// ReadFloat for numbers of any form.
float ReadOddFloat(const char* text, const char* end, const char*& next, ENumber& kind);

/// The most bytes that AppendFixed6 writes: sign, 39 digits, point, 6 digits.
inline constexpr size_t kFixed6Bytes = 48;
/// Writes a number as "%f" does in the C locale ("-0.000000", "inf", "-nan" included) and answers the end of
/// it. Exact, also where a float's decimal expansion is cut.
char* WriteFixed6(char* out, float value);
/// The most bytes that WriteShortest writes: sign, "0.", 44 zeros and nine digits.
inline constexpr size_t kShortestBytes = 64;
/// Writes a number in the fewest decimals that read back as the same float, without an exponent, and answers
/// the end of it.
char* WriteShortest(char* out, float value);
/// The most bytes that WriteInt writes.
inline constexpr size_t kIntBytes = 12;
/// Writes a number as "%d" does and answers the end of it.
char* WriteInt(char* out, int32_t value);

void AppendFixed6(std::string& out, float value);
/// The same with three decimals, as "%.3f" does, for what is only looked at.
void AppendFixed3(std::string& out, float value);
/// The same with any number of decimals, and without a sign before what rounds to 0.
void AppendFixed(std::string& out, double value, int decimals);
void AppendInt(std::string& out, int32_t value);

} // namespace gw
