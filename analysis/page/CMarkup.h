#pragma once

#include <string>
#include <string_view>

namespace gw {

/// The text of a page as it grows. Markup is taken as it is; whatever comes from a file goes through Name.
class CMarkup
{
public:
    CMarkup& Raw(std::string_view markup)
    {
        m_kText += markup;
        return *this;
    }
    /// A name from a file as text or between the quotes of an attribute: nothing in it can be markup, control
    /// characters and bytes that are no UTF-8 stand as \xNN, and a very long one is cut.
    CMarkup& Name(std::string_view name);
    /// The name of the file that a path leads to, with the whole path behind it for whoever points there.
    CMarkup& FileName(std::string_view path);
    CMarkup& Number(double value, int decimals);
    CMarkup& Integer(long long value);

    const std::string& Text() const { return m_kText; }

private:
    std::string m_kText;
};

} // namespace gw
