#include "HTMLMarkup.h"

#include "CObject.h"
#include "HTMLText.h"

namespace gw {

namespace {

constexpr std::string_view kTags[][2] = {
    {"<H1>", "</H1>"}, // Heading
    {"<TR>", "</TR>"}, // TableRow
    {"<TH>", "</TH>"}, // HeaderCell
    {"<TD>", "</TD>"}, // DataCell
    {"<!--", "-->"  }, // Comment
};

constexpr std::string_view kHere = ".\\"; // browsers treat the backslash like a slash

} // namespace

std::string HTMLLineBreak()
{
    return "<BR>";
}

std::string HTMLRule()
{
    return "<HR>";
}

std::string HTMLTag(EHTMLElement element, EHTMLEnd end)
{
    return std::string(kTags[static_cast<size_t>(element)][static_cast<size_t>(end)]);
}

std::string HTMLEnclosed(EHTMLElement element, std::string_view text)
{
    return HTMLTag(element, EHTMLEnd::Opening).append(text) + HTMLTag(element, EHTMLEnd::Closing);
}

std::string HTMLTable(EHTMLEnd end, unsigned border)
{
    if (end == EHTMLEnd::Closing)
        return "</CAPTION></TABLE>";
    return "<TABLE BORDER=\"" + std::to_string(border) + "\"><CAPTION>";
}

std::string HTMLUnsigned(uint32_t value)
{
    return std::to_string(value);
}

std::string HTMLAnchor(std::string_view url, std::string_view text)
{
    std::string anchor = "<A HREF=\"";
    if (url.find('\\') == url.npos)
        anchor += kHere;
    anchor += url;
    if (url.find('.') == url.npos)
        anchor += ".htm";
    return anchor.append("\">").append(text);
}

std::string GetHTMLFileName(const CObject& object, EHTMLPath path)
{
    const std::string_view folder = path == EHTMLPath::Relative ? kHere : "";
    return std::string(folder) + "OrnHTML" + HTMLUnsigned(object.GetID()) + ".htm";
}

std::string HTMLObjectAnchor(const CObject* object)
{
    if (!object)
        return "NULL";
    std::string text = object->GetRTTI()->m_pcName;
    if (!object->NameView().empty())
        text += ' ' + HTMLText(object->NameView());
    return HTMLAnchor(GetHTMLFileName(*object, EHTMLPath::Relative), text);
}

} // namespace gw
