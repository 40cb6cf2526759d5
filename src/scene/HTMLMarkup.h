#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace gw {

class CObject;

/// The elements of a page that have two ends.
enum class EHTMLElement : uint8_t
{
    Heading,
    TableRow,
    HeaderCell,
    DataCell,
    Comment,
};

enum class EHTMLEnd : uint8_t
{
    Opening,
    Closing,
};

std::string HTMLLineBreak();
std::string HTMLRule();
std::string HTMLTag(EHTMLElement element, EHTMLEnd end);
/// The text with the tags of the element around it.
std::string HTMLEnclosed(EHTMLElement element, std::string_view text);
/// A table that opens with a caption and closes the caption at its end: the rows stand inside, which browsers
/// put right.
std::string HTMLTable(EHTMLEnd end, unsigned border);
std::string HTMLUnsigned(uint32_t value);
/// A link without its closing tag. A bare name gets the folder and the extension of the pages.
std::string HTMLAnchor(std::string_view url, std::string_view text);

enum class EHTMLPath : uint8_t
{
    Bare,
    Relative, ///< to the folder of the page that names it
};

/// The file of an object's page. It follows the object's id, so that another load gives other names.
std::string GetHTMLFileName(const CObject& object, EHTMLPath path);

/// An anchor to an object's page under its class and name, or "NULL".
std::string HTMLObjectAnchor(const CObject* object);

/// The line by which a page tells its code page.
inline constexpr char kHTMLCodePage[] =
    R"(<meta http-equiv="Content-Type" content="text/html; charset=big5">)";

// What the pages say in Big5, whose characters take two bytes each.

inline constexpr char kHTMLMembers[] = "\xA6\xA8\xAD\xFB\xB8\xEA\xAE\xC6";    ///< member data
inline constexpr char kHTMLObjectName[] = "\xAA\xAB\xA5\xF3\xA6\x57\xBA\xD9"; ///< object name
inline constexpr char kHTMLControls[] = "\xB1\xB1\xA8\xEE\xAA\xAB\xA5\xF3";   ///< control objects
inline constexpr char kHTMLObjectID[] = "\xAA\xAB\xA5\xF3\x49\x44";           ///< object id
inline constexpr char kHTMLContents[] = "\xA4\xBA\xAE\x65";                   ///< contents

} // namespace gw
