#include "NamePrefix.h"

#include "JointWords.h"
#include "Text.h"

#include <algorithm>
#include <map>
#include <vector>

namespace gw {

namespace {

// Every start of every name is tried on every name, so both are bounded: a body's joints stand among the
// first, and no prefix is longer than a short title.
constexpr size_t kNamesLooked = 256;
constexpr size_t kLongestPrefix = 32;
// A prefix is a habit of the skeleton: so many joints at least have it, and a third of those looked at.
constexpr size_t kLeastNames = 8;

bool IsWordCharacter(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= '0' && c <= '9') || (c & 0x80) != 0;
}

size_t CountUnderstood(std::span<const std::string_view> names, std::string_view prefix)
{
    return static_cast<size_t>(std::ranges::count_if(names, [=](std::string_view name) {
        return ReadJointName(WithoutPrefix(name, prefix)).word != EJointWord::None;
    }));
}

std::vector<std::string> SharedStarts(std::span<const std::string_view> names)
{
    std::map<std::string, size_t> counts;
    for (const std::string_view name : names)
    {
        const std::string lower = LowerCase(name);
        for (size_t length = 1; length < std::min(lower.size(), kLongestPrefix + 1); ++length)
            ++counts[lower.substr(0, length)];
    }
    std::vector<std::string> starts;
    for (const auto& [start, count] : counts)
    {
        if (count >= std::max(kLeastNames, names.size() / 3))
            starts.push_back(start);
    }
    return starts;
}

} // namespace

std::string_view WithoutNamespace(std::string_view name)
{
    const size_t colon = name.rfind(':');
    return colon == name.npos ? name : name.substr(colon + 1);
}

std::string FindNamePrefix(std::span<const std::string_view> names)
{
    names = names.first(std::min(names.size(), kNamesLooked));
    std::string best;
    size_t most = CountUnderstood(names, best);
    for (std::string& start : SharedStarts(names))
    {
        const size_t understood = CountUnderstood(names, start);
        // What separates a prefix from the name belongs to the prefix.
        const bool closes = !best.empty() && start.starts_with(best) && !IsWordCharacter(start.back());
        if (understood < most || (understood == most && !closes))
            continue;
        most = understood;
        best = std::move(start);
    }
    return best;
}

std::string_view WithoutPrefix(std::string_view name, std::string_view prefix)
{
    const bool has = name.size() > prefix.size() && EqualNoCase(name.substr(0, prefix.size()), prefix);
    return has ? name.substr(prefix.size()) : name;
}

} // namespace gw
