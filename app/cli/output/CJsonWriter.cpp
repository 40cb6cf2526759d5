// A streaming JSON writer. Strings are escaped by the JSON library; structure and line breaks are
// written here.

#include "CJsonWriter.h"

#include <nlohmann/json.hpp>

#include <charconv>
#include <cmath>

namespace gw {

namespace {

constexpr size_t kGatherBytes = size_t{1} << 16;

// The library only escapes control characters below U+0020. Terminals also obey those from U+007F to U+009F.
std::string WithEscapedControls(const std::string& json)
{
    std::string escaped;
    escaped.reserve(json.size());
    for (size_t i = 0; i < json.size(); ++i)
    {
        const bool isPair =
            json[i] == '\xc2' && static_cast<unsigned char>(json[i + 1]) < 0xa0; // the input is valid UTF-8
        if (!isPair && json[i] != '\x7f')
        {
            escaped += json[i];
            continue;
        }
        char digits[8];
        i += isPair ? 1 : 0;
        std::snprintf(digits, sizeof digits, "\\u%04x", static_cast<unsigned char>(json[i]));
        escaped += digits;
    }
    return escaped;
}

} // namespace

void CJsonWriter::Flush()
{
    std::fwrite(m_kText.data(), 1, m_kText.size(), m_pkFile);
    m_kText.clear();
}

void CJsonWriter::Separate()
{
    if (m_bComma)
        m_kText += ',';
    if (m_bBreak)
        m_kText += '\n';
    m_bComma = false;
    m_bBreak = false;
    if (m_kText.size() > kGatherBytes)
        Flush();
}

void CJsonWriter::Plain(std::string_view text)
{
    Separate();
    m_kText += text;
    m_bComma = true;
}

void CJsonWriter::Begin(char bracket)
{
    Separate();
    m_kText += bracket;
}

void CJsonWriter::End(char bracket)
{
    m_bComma = false;
    Separate();
    m_kText += bracket;
    m_bComma = true;
}

CJsonWriter& CJsonWriter::Key(std::string_view name)
{
    Text(name);
    m_kText += ':';
    m_bComma = false;
    return *this;
}

void CJsonWriter::Text(std::string_view text)
{
    const nlohmann::json value(text);
    Plain(WithEscapedControls(value.dump(-1, ' ', false, nlohmann::json::error_handler_t::replace)));
}

void CJsonWriter::Integer(int64_t value)
{
    char digits[24];
    Plain({digits, std::to_chars(digits, std::end(digits), value).ptr});
}

void CJsonWriter::Number(float value)
{
    if (std::isnan(value))
        return Plain("\"nan\"");
    if (std::isinf(value))
        return Plain(value > 0.0f ? "\"inf\"" : "\"-inf\"");
    char digits[32];
    Plain({digits, std::to_chars(digits, std::end(digits), value).ptr});
}

void CJsonWriter::Numbers(std::span<const float> values)
{
    BeginArray();
    for (const float value : values)
        Number(value);
    EndArray();
}

void CJsonWriter::EndDocument()
{
    m_kText += '\n';
    m_bComma = false;
    Flush();
}

} // namespace gw
