#pragma once

#include <cstdint>
#include <cstdio>
#include <span>
#include <string>
#include <string_view>

namespace gw {

/// JSON on its way to a file, written as it comes: a large scene is never in memory a second time. What is no
/// number becomes the text "nan", "inf" or "-inf", bytes that are no UTF-8 become U+FFFD, and all control
/// characters are escaped, so that every reader accepts the result and no terminal obeys it.
class CJsonWriter
{
public:
    explicit CJsonWriter(std::FILE* file) : m_pkFile(file) {}
    ~CJsonWriter() { Flush(); }
    CJsonWriter(const CJsonWriter&) = delete;
    CJsonWriter& operator=(const CJsonWriter&) = delete;

    void BeginObject() { Begin('{'); }
    void EndObject() { End('}'); }
    void BeginArray() { Begin('['); }
    void EndArray() { End(']'); }
    /// The key of the value that comes next.
    CJsonWriter& Key(std::string_view name);

    void Text(std::string_view text);
    void Integer(int64_t value);
    void Number(float value);
    void Bool(bool value) { Plain(value ? "true" : "false"); }
    void Null() { Plain("null"); }
    void Numbers(std::span<const float> values);

    /// The next value of an array, or its end, begins a line.
    void BreakLine() { m_bBreak = true; }
    /// Ends a document with a line end; another may follow.
    void EndDocument();

private:
    void Begin(char bracket);
    void End(char bracket);
    void Plain(std::string_view text);
    void Separate();
    void Flush();

    std::FILE* m_pkFile;
    std::string m_kText;
    bool m_bComma = false;
    bool m_bBreak = false;
};

} // namespace gw
