#pragma once

#include <nlohmann/json.hpp>

#include <cstdint>
#include <string>
#include <string_view>

namespace gw {

/// Returns a text as a JSON string. Bytes that are not UTF-8 become U+FFFD.
inline std::string JsonString(std::string_view text)
{
    return nlohmann::json(text).dump(-1, ' ', false, nlohmann::json::error_handler_t::replace);
}

/// Builds one JSON object on one line, without a tree, whose destruction allocates memory.
class CJsonLine
{
public:
    CJsonLine& Add(std::string_view key, std::string_view text) { return AddJson(key, JsonString(text)); }
    CJsonLine& Add(std::string_view key, uint64_t count) { return AddJson(key, std::to_string(count)); }
    /// Adds a member whose value is already JSON.
    CJsonLine& AddJson(std::string_view key, std::string_view json)
    {
        m_kText.append(m_kText.size() > 1 ? "," : "").append(JsonString(key)).append(":").append(json);
        return *this;
    }
    std::string Text() const { return m_kText + '}'; }

private:
    std::string m_kText = "{";
};

} // namespace gw
