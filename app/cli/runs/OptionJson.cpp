// Stores options in plans and resume keys. Only options that differ from their defaults are written, so
// spelling out a default changes nothing.

#include "OptionJson.h"

#include "CJsonMembers.h"
#include "JsonText.h"
#include "OptionTable.h"

#include <algorithm>

namespace gw {

namespace {

using Json = nlohmann::json; // only for single values, never for trees

// The types of the record's members. The size of a picture is never part of a conversion.
template <class T>
concept Plain = std::same_as<T, bool> || std::same_as<T, std::string> || std::same_as<T, float> ||
    std::same_as<T, int64_t>;

struct COptionValue
{
    const ShellOptions& options;

    template <Plain T>
    Json operator()(T ShellOptions::*target) const
    {
        return options.*target == ShellOptions().*target ? Json() : Json(options.*target);
    }
    template <Plain T>
    Json operator()(std::optional<T> ShellOptions::*target) const
    {
        return options.*target ? Json(*(options.*target)) : Json();
    }
    Json operator()(PixelSize ShellOptions::*) const { return {}; }
};

struct COptionTaker
{
    using EKind = CJsonMembers::EKind;

    const CJsonMembers::Member& value;
    ShellOptions& options;

    template <Plain T>
    bool operator()(T ShellOptions::*target) const
    {
        return Take(options.*target);
    }
    template <Plain T>
    bool operator()(std::optional<T> ShellOptions::*target) const
    {
        return Take((options.*target).emplace());
    }
    bool operator()(PixelSize ShellOptions::*) const { return false; }

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

std::string FirstName(const OptionRow& row)
{
    return std::string(row.names.substr(0, row.names.find(',')));
}

} // namespace

std::string OptionsJson(const ShellOptions& options, uint64_t bits)
{
    CJsonLine json;
    for (const OptionRow& row : OptionTable())
    {
        const Json value = bits & row.bit ? std::visit(COptionValue{options}, row.target) : Json();
        if (!value.is_null())
            json.AddJson(FirstName(row), value.dump(-1, ' ', false, Json::error_handler_t::replace));
    }
    return json.Text();
}

bool ReadOptionsJson(std::string_view text, uint64_t bits, ShellOptions& options, std::string& wrong)
{
    CJsonMembers json;
    json.Read(text);
    if (!json.IsObject())
        return false;
    for (const CJsonMembers::Member& value : json.Members())
    {
        const auto row = std::ranges::find_if(
            OptionTable(), [&](const OptionRow& r) { return (bits & r.bit) && FirstName(r) == value.key; });
        wrong = value.key;
        if (row == OptionTable().end() || !std::visit(COptionTaker{value, options}, row->target))
            return false;
    }
    return true;
}

} // namespace gw
