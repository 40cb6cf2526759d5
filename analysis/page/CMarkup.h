#pragma once

#include <string>
#include <string_view>

namespace gw {

/// The growing text of a page. Markup is appended unchanged; text from files must go through Name.
class CMarkup
{
public:
    CMarkup& Raw(std::string_view markup)
    {
        m_kText += markup;
        return *this;
    }
    /// Appends a name from a file as text or inside a quoted attribute. Markup is escaped, control characters
    /// and bytes that are not UTF-8 become \xNN, and very long names are cut.
    CMarkup& Name(std::string_view name);
    /// Appends the file name of a path, with the whole path in its tool tip.
    CMarkup& FileName(std::string_view path);
    /// Appends a relative path as a link inside a quoted attribute.
    CMarkup& Link(std::string_view path);
    /// Appends text from a file as a JSON string, quotes included, that is safe inside an element.
    CMarkup& JsonText(std::string_view text);
    /// Appends bytes in base64.
    CMarkup& Base64(std::string_view bytes);
    CMarkup& Number(double value, int decimals);
    CMarkup& Integer(long long value);

    const std::string& Text() const { return m_kText; }

private:
    std::string m_kText;
};

} // namespace gw
