#include "OptionJson.h"

#include "CJsonMembers.h"
#include "JsonText.h"
#include "OptionTable.h"

#include <algorithm>

namespace gw {

namespace {

using Json = nlohmann::json; // for single values: nothing here builds a tree

// What a member of the record can be. The size of a picture is nothing that a conversion asks for.
template <class T>
concept Plain = std::same_as<T, bool> || std::same_as<T, std::string> || std::same_as<T, float> ||
    std::same_as<T, int64_t>;

struct COptionValue
{
    const COptions& options;

    template <Plain T>
    Json operator()(T COptions::*target) const
    {
        return options.*target == COptions().*target ? Json() : Json(options.*target);
    }
    template <Plain T>
    Json operator()(std::optional<T> COptions::*target) const
    {
        return options.*target ? Json(*(options.*target)) : Json();
    }
    Json operator()(CPixelSize COptions::*) const { return {}; }
};

struct COptionTaker
{
    using EKind = CJsonMembers::EKind;

    const CJsonMembers::Member& value;
    COptions& options;

    template <Plain T>
    bool operator()(T COptions::*target) const
    {
        return Take(options.*target);
    }
    template <Plain T>
    bool operator()(std::optional<T> COptions::*target) const
    {
        return Take((options.*target).emplace());
    }
    bool operator()(CPixelSize COptions::*) const { return false; }

    template <Plain T>
    bool Take(T& member) const
    {
        if constexpr (std::same_as<T, bool>)
            return Take(member, value.flag, value.kind == EKind::Bool);
        else if constexpr (std::same_as<T, std::string>)
            return Take(member, value.text, value.kind == EKind::Text);
        else if constexpr (std::same_as<T, int64_t>)
            return Take(member, value.integer, value.kind == EKind::Integer);
        else
            return Take(member, static_cast<float>(value.number),
                        value.kind == EKind::Integer || value.kind == EKind::Number);
    }
    template <Plain T>
    bool Take(T& member, const T& found, bool fits) const
    {
        if (fits)
            member = found;
        return fits;
    }
};

std::string FirstName(const COptionRow& row)
{
    return std::string(row.names.substr(0, row.names.find(',')));
}

} // namespace

std::string OptionsJson(const COptions& options, uint64_t bits)
{
    CJsonLine json;
    for (const COptionRow& row : OptionTable())
    {
        const Json value = bits & row.bit ? std::visit(COptionValue{options}, row.target) : Json();
        if (!value.is_null())
            json.AddJson(FirstName(row), value.dump(-1, ' ', false, Json::error_handler_t::replace));
    }
    return json.Text();
}

bool ReadOptionsJson(std::string_view text, uint64_t bits, COptions& options, std::string& wrong)
{
    CJsonMembers json;
    json.Read(text);
    if (!json.IsObject())
        return false;
    for (const CJsonMembers::Member& value : json.Members())
    {
        const auto row = std::ranges::find_if(
            OptionTable(), [&](const COptionRow& r) { return (bits & r.bit) && FirstName(r) == value.key; });
        wrong = value.key;
        if (row == OptionTable().end() || !std::visit(COptionTaker{value, options}, row->target))
            return false;
    }
    return true;
}

} // namespace gw
