#pragma once

#include <nlohmann/json.hpp>

#include <string>

namespace gw {

/// A member of a JSON object that is to be a text. False for any other.
inline bool TakeText(const nlohmann::ordered_json& json, const char* key, std::string& text)
{
    const auto found = json.is_object() ? json.find(key) : json.end();
    if (found == json.end() || !found->is_string())
        return false;
    text = found->get<std::string>();
    return true;
}

/// A JSON value on one line. Bytes that are no UTF-8 become U+FFFD.
inline std::string DumpJson(const nlohmann::ordered_json& json)
{
    return json.dump(-1, ' ', false, nlohmann::json::error_handler_t::replace);
}

} // namespace gw
