#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace gw {

class CObject;

/// Elements with a start and an end tag.
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
/// Returns the text enclosed in the element's tags.
std::string HTMLEnclosed(EHTMLElement element, std::string_view text);
/// Returns a table's start or end tags. The start opens a caption that only the end closes, so the rows are
/// inside it; browsers repair that.
std::string HTMLTable(EHTMLEnd end, unsigned border);
std::string HTMLUnsigned(uint32_t value);
/// Returns a link without its closing tag. The folder and extension of the pages are added to a bare name.
std::string HTMLAnchor(std::string_view url, std::string_view text);

enum class EHTMLPath : uint8_t
{
    Bare,
    Relative, ///< to the folder of the linking page
};

/// Returns the name of an object's page. It contains the object's id, so it differs after another load.
std::string GetHTMLFileName(const CObject& object, EHTMLPath path);

/// Returns a link to an object's page, labeled with its class and name, or "NULL".
std::string HTMLObjectAnchor(const CObject* object);

/// Declares the code page of a page.
inline constexpr char kHTMLCodePage[] =
    R"(<meta http-equiv="Content-Type" content="text/html; charset=big5">)";

// Labels of the pages in Big5, which uses two bytes per character.

inline constexpr char kHTMLMembers[] = "\xA6\xA8\xAD\xFB\xB8\xEA\xAE\xC6";    ///< member data
inline constexpr char kHTMLObjectName[] = "\xAA\xAB\xA5\xF3\xA6\x57\xBA\xD9"; ///< object name
inline constexpr char kHTMLControls[] = "\xB1\xB1\xA8\xEE\xAA\xAB\xA5\xF3";   ///< control objects
inline constexpr char kHTMLObjectID[] = "\xAA\xAB\xA5\xF3\x49\x44";           ///< object id
inline constexpr char kHTMLContents[] = "\xA4\xBA\xAE\x65";                   ///< contents

} // namespace gw
