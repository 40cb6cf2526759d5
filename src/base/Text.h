#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// Returns whether two names are equal, ignoring the case of ASCII letters.
bool EqualNoCase(std::string_view a, std::string_view b);
/// Returns a copy with ASCII letters in lower or upper case.
std::string LowerCase(std::string_view text);
std::string UpperCase(std::string_view text);
/// Returns the text without trailing blanks and line feeds.
std::string_view CutTrailing(std::string_view text);

/// Token separators of all text motion formats: blank, comma, tab and line feed.
inline constexpr std::string_view kTokenDelimiters = " ,\t\n";
/// Removes and returns the first token of a text; any run of delimiters separates. Empty if there are no
/// more.
std::string_view NextToken(std::string_view& rest);
/// The same with other delimiters.
std::string_view NextToken(std::string_view& rest, std::string_view delimiters);
/// Removes and returns the next token as sscanf's "%s" does, separated by blanks, tabs and line ends. Empty
/// if there are no more.
std::string_view NextWord(std::string_view& rest);

/// Removes the first line of a text and stores it without its LF or CR LF. False at the end of the text.
bool NextLine(std::string_view& rest, std::string_view& line);
/// Returns the text without a leading UTF-8 byte order mark.
std::string_view SkipByteOrderMark(std::string_view text);

/// Returns a text that is safe to print: control characters become \xNN, so a name in a file cannot control a
/// terminal.
std::string Printable(std::string_view text);
/// Returns a name from a file in double quotes, safe to print.
std::string Quoted(std::string_view name);
/// Returns the candidate closest to a name by edit distance, ignoring case, or empty if none is similar.
std::string NearestName(std::string_view name, const std::vector<std::string>& candidates);

} // namespace gw
