// Reads one level of JSON without building a tree. The parser sends events; a member that is itself an object
// or array is written back to text and can be parsed in turn. Depth is limited, so memory and time are
// proportional to the text.

#include "CJsonMembers.h"

#include "JsonText.h"

#include <algorithm>
#include <limits>
#include <utility>

namespace gw {

namespace {

using Member = CJsonMembers::Member;
using EKind = CJsonMembers::EKind;

// Receives the events of the JSON library's parser, which is not recursive. Values of the outermost object or
// array become members; deeper ones are appended to the text of the member that contains them.
class CMemberCollector
{
public:
    using number_integer_t = nlohmann::json::number_integer_t;
    using number_unsigned_t = nlohmann::json::number_unsigned_t;
    using number_float_t = nlohmann::json::number_float_t;
    using string_t = nlohmann::json::string_t;
    using binary_t = nlohmann::json::binary_t;

    bool null() { return Take({.kind = EKind::Null}, "null"); }
    bool boolean(bool value) { return Take({.kind = EKind::Bool, .flag = value}, value ? "true" : "false"); }
    bool number_integer(number_integer_t value)
    {
        return Take({.kind = EKind::Integer, .integer = value, .number = static_cast<double>(value)},
                    std::to_string(value));
    }
    bool number_unsigned(number_unsigned_t value)
    {
        const bool fits = value <= std::numeric_limits<int64_t>::max();
        return Take({.kind = fits ? EKind::Integer : EKind::Number,
                     .integer = fits ? static_cast<int64_t>(value) : 0,
                     .number = static_cast<double>(value)},
                    std::to_string(value));
    }
    bool number_float(number_float_t value, const string_t& digits)
    {
        return Take({.kind = EKind::Number, .number = value}, digits);
    }
    bool string(string_t& value)
    {
        const std::string quoted = m_uiDepth > 1 ? JsonString(value) : std::string();
        return Take({.kind = EKind::Text, .text = std::move(value)}, quoted);
    }
    bool binary(binary_t&) { return false; }
    bool start_object(size_t) { return Begin('{'); }
    bool start_array(size_t) { return Begin('['); }
    bool end_object() { return End('}'); }
    bool end_array() { return End(']'); }
    bool key(string_t& value)
    {
        if (m_uiDepth == 1)
            m_kKey = std::move(value);
        else
            Append(JsonString(value) + ':');
        return true;
    }
    bool parse_error(size_t, const std::string&, const nlohmann::detail::exception&) { return false; }

    bool IsTooDeep() const { return m_uiDepth > kJsonDepthLimit; }
    bool IsObject() const { return m_bObject; }
    std::vector<Member>&& TakeMembers() { return std::move(m_kMembers); }

private:
    // A single value, outside any object or array.
    bool Take(Member&& member, std::string_view json)
    {
        if (m_uiDepth == 1)
            Add(std::move(member));
        else if (m_uiDepth > 1)
            Append(json);
        return m_uiDepth > 0;
    }

    void Add(Member&& member)
    {
        member.key = std::exchange(m_kKey, {});
        m_kMembers.push_back(std::move(member));
    }

    void Append(std::string_view json)
    {
        std::string& text = m_kMembers.back().text;
        if (!text.empty() && std::string_view("{[:").find(text.back()) == std::string_view::npos)
            text += ',';
        text += json;
    }

    bool Begin(char bracket)
    {
        ++m_uiDepth;
        if (m_uiDepth == 1)
            m_bObject = bracket == '{';
        else if (m_uiDepth == 2)
            Add({.kind = EKind::Nested});
        if (m_uiDepth > 1)
            Append(std::string_view(&bracket, 1));
        return !IsTooDeep();
    }

    bool End(char bracket)
    {
        if (m_uiDepth > 1)
            m_kMembers.back().text += bracket;
        --m_uiDepth;
        return true;
    }

    size_t m_uiDepth = 0;
    bool m_bObject = false;
    std::string m_kKey;
    std::vector<Member> m_kMembers;
};

} // namespace

EFailure CJsonMembers::Read(std::string_view text)
{
    *this = {};
    CMemberCollector collector;
    if (!nlohmann::json::sax_parse(text, &collector))
        return collector.IsTooDeep() ? EFailure::TooDeep : EFailure::UnexpectedLine;
    m_bObject = collector.IsObject();
    m_kMembers = collector.TakeMembers();
    return EFailure::None;
}

const Member* CJsonMembers::Find(std::string_view key) const
{
    const auto found = std::find_if(m_kMembers.rbegin(), m_kMembers.rend(),
                                    [=](const Member& member) { return member.key == key; });
    return found == m_kMembers.rend() ? nullptr : &*found;
}

bool CJsonMembers::TakeText(std::string_view key, std::string& text) const
{
    const Member* const member = Find(key);
    if (!member || member->kind != EKind::Text)
        return false;
    text = member->text;
    return true;
}

bool CJsonMembers::TakeCount(std::string_view key, uint64_t& count) const
{
    const Member* const member = Find(key);
    if (!member || member->kind != EKind::Integer || member->integer < 0)
        return false;
    count = static_cast<uint64_t>(member->integer);
    return true;
}

} // namespace gw
