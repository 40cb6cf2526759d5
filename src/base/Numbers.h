#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace gw {

/// Classifies a text that should be a number.
enum class ENumber : uint8_t
{
    None,    ///< not a number: "abc", "", "-"
    Whole,   ///< the whole text is one finite number
    Stuck,   ///< a finite number followed directly by other characters: "0.0-7.5"
    Unusual, ///< "nan", "inf", or too large for the type
};

/// Same as atof in the C locale, whatever the desktop's locale is: skips leading blanks and one sign, ignores
/// what follows the number, and returns 0 if there is no number.
double ParseDouble(std::string_view text);
/// Also classifies the text, for readers that warn about or refuse odd numbers.
double ParseDouble(std::string_view text, ENumber& kind);
/// Same as sscanf with "%f" in the C locale. Returns false and leaves value unchanged if there is no number.
/// Parsed as 64 bits, then narrowed.
bool ScanFloat(std::string_view text, float& value);
bool ScanFloat(std::string_view text, float& value, ENumber& kind);
/// Same as atoi: leading blanks, a sign, digits; 0 without digits. Out-of-range numbers are clamped to 32
/// bits.
int32_t ParseInt(std::string_view text);
/// Same as sscanf with "%d"; returns false and leaves value unchanged if there are no digits.
bool ScanInt(std::string_view text, int32_t& value);

/// The slow path of ReadFloat, for numbers in any form.
float ReadOddFloat(const char* text, const char* end, const char*& next, ENumber& kind);

/// Maximum number of bytes that WriteFixed6 writes: sign, 39 digits, point, 6 digits.
inline constexpr size_t kFixed6Bytes = 48;
/// Writes a number as "%f" does in the C locale ("-0.000000", "inf" and "-nan" included) and returns the end.
/// Rounds exactly.
char* WriteFixed6(char* out, float value);
/// Maximum number of bytes that WriteShortest writes: sign, "0.", 44 zeros and nine digits.
inline constexpr size_t kShortestBytes = 64;
/// Writes a number with the fewest decimals that read back as the same float, without an exponent. Returns
/// the end.
char* WriteShortest(char* out, float value);
/// Maximum number of bytes that WriteInt writes.
inline constexpr size_t kIntBytes = 12;
/// Writes a number as "%d" does and returns the end.
char* WriteInt(char* out, int32_t value);

void AppendFixed6(std::string& out, float value);
/// Same with three decimals, as "%.3f" does, for display only.
void AppendFixed3(std::string& out, float value);
/// Same with any number of decimals, and without a minus sign if the result rounds to 0.
void AppendFixed(std::string& out, double value, int decimals);
void AppendInt(std::string& out, int32_t value);

} // namespace gw
