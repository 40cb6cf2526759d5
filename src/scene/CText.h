#pragma once

#include <string>
#include <string_view>

namespace gw {

/// An owned text that may be null. A null text and an empty one are both legal and differ only in searches.
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
    /// Takes bytes as read from a file: none give a null text, a zero byte ends it.
    void SetBytes(std::string_view bytes)
    {
        m_bNull = bytes.empty();
        m_kText = bytes.substr(0, bytes.find('\0'));
    }

    bool IsNull() const { return m_bNull; }
    /// The text with its terminator, or null.
    const char* Get() const { return m_bNull ? nullptr : m_kText.c_str(); }
    /// The characters; none for a null text.
    std::string_view View() const { return m_kText; }
    /// What GetMemoryUsed counts: the characters and the terminator when set, else 0.
    size_t MemoryUsed() const { return m_bNull ? 0 : m_kText.size() + 1; }

private:
    std::string m_kText;
    bool m_bNull = true;
};

} // namespace gw
