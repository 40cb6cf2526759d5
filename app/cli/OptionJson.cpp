#include "OptionJson.h"

#include "JsonText.h"
#include "OptionTable.h"

#include <algorithm>

namespace gw {

namespace {

using Json = nlohmann::ordered_json;

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
    const Json& value;
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
        const bool fits = std::same_as<T, bool>          ? value.is_boolean()
                          : std::same_as<T, std::string> ? value.is_string()
                          : std::same_as<T, float>       ? value.is_number()
                                                         : value.is_number_integer();
        if (fits)
            member = value.get<T>();
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
    Json json = Json::object();
    for (const COptionRow& row : OptionTable())
    {
        const Json value = bits & row.bit ? std::visit(COptionValue{options}, row.target) : Json();
        if (!value.is_null())
            json[FirstName(row)] = value;
    }
    return DumpJson(json);
}

bool ReadOptionsJson(std::string_view text, uint64_t bits, COptions& options, std::string& wrong)
{
    const Json json = Json::parse(text, nullptr, false);
    if (!json.is_object())
        return false;
    for (const auto& [name, value] : json.items())
    {
        const auto row = std::ranges::find_if(OptionTable(), [bits, &name = name](const COptionRow& r) {
            return (bits & r.bit) && FirstName(r) == name;
        });
        wrong = name;
        if (row == OptionTable().end() || !std::visit(COptionTaker{value, options}, row->target))
            return false;
    }
    return true;
}

} // namespace gw
