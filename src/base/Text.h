#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// Whether two names are equal without regard to the case of ASCII letters.
bool EqualNoCase(std::string_view a, std::string_view b);
/// A copy with ASCII letters in lower or upper case.
std::string LowerCase(std::string_view text);
std::string UpperCase(std::string_view text);
/// The text without the blanks and line feeds at its end.
std::string_view CutTrailing(std::string_view text);

/// What separates tokens in every text motion format: blank, comma, tab and line feed.
inline constexpr std::string_view kTokenDelimiters = " ,\t\n";
/// Takes the next token off the front of a text: any run of delimiters separates. Empty when none is left.
std::string_view NextToken(std::string_view& rest, std::string_view delimiters = kTokenDelimiters);
/// Takes the next token as sscanf's "%s" does, at blanks, tabs and line ends. Empty when none is left.
std::string_view NextWord(std::string_view& rest);

/// Takes the next line off the front of a text, without its LF or CR LF. False when the text is used up.
bool NextLine(std::string_view& rest, std::string_view& line);
/// The text behind a UTF-8 byte order mark, or the text itself.
std::string_view SkipByteOrderMark(std::string_view text);

/// A text as it may be printed: control characters as \xNN, so that a name in a file cannot command a
/// terminal.
std::string Printable(std::string_view text);
/// A name from a file in double quotes, as Printable shows it.
std::string Quoted(std::string_view name);
/// The candidate nearest to a name by edit distance without regard to case, or empty when none is near.
std::string NearestName(std::string_view name, const std::vector<std::string>& candidates);

} // namespace gw
