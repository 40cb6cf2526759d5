#pragma once

#include <string>
#include <string_view>

namespace gw {

/// An owned text that may be null. Null and empty are both valid and differ only in searches.
class CText
{
public:
    CText() = default;
    CText(const char* text) { Set(text); }

    void Set(const char* text)
    {
        m_bNull = !text;
        m_kText = text ? text : "";
    }
    /// Sets the text to bytes from a file: no bytes make it null, a zero byte ends it.
    void SetBytes(std::string_view bytes)
    {
        m_bNull = bytes.empty();
        m_kText = bytes.substr(0, bytes.find('\0'));
    }

    bool IsNull() const { return m_bNull; }
    /// Returns the null-terminated text, or null.
    const char* Get() const { return m_bNull ? nullptr : m_kText.c_str(); }
    /// Returns the characters; empty for a null text.
    std::string_view View() const { return m_kText; }
    /// Returns the size for GetMemoryUsed: characters plus terminator, or 0 for null.
    size_t MemoryUsed() const { return m_bNull ? 0 : m_kText.size() + 1; }

private:
    std::string m_kText;
    bool m_bNull = true;
};

} // namespace gw
