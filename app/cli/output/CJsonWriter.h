#pragma once

#include <cstdint>
#include <cstdio>
#include <span>
#include <string>
#include <string_view>

namespace gw {

/// Writes JSON to a file as it is generated, so a large scene is not in memory twice. NaN and infinities
/// become the texts "nan", "inf" and "-inf", bytes that are not UTF-8 become U+FFFD, and all control
/// characters are escaped, so that every parser accepts the result and no terminal is affected.
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
    /// Writes the key of the next value.
    CJsonWriter& Key(std::string_view name);

    void Text(std::string_view text);
    void Integer(int64_t value);
    void Number(float value);
    void Bool(bool value) { Plain(value ? "true" : "false"); }
    void Null() { Plain("null"); }
    void Numbers(std::span<const float> values);

    /// Starts a new line before the next value of an array, or its end, for people and line tools. Not for
    /// documents that programs read line by line.
    void BreakLine() { m_bBreak = true; }
    /// Ends a document with a line end; another can follow.
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
