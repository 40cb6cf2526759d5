#include "SharedPrefix.h"

#include "Text.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// A root above the body, props and helpers are often outside the namespace.
constexpr double kNearlyAll = 0.8;
// A prefix is shared by several joints; two joints with the same first letter do not have one.
constexpr size_t kLeastNames = 5;
// A body's joints are among the first.
constexpr size_t kNamesLooked = 256;
constexpr std::string_view kSeparators = ":_-";

size_t LengthInCommon(std::string_view a, std::string_view b)
{
    const auto ends = std::ranges::mismatch(
        a, b, [](char x, char y) { return EqualNoCase(std::string_view(&x, 1), std::string_view(&y, 1)); });
    return static_cast<size_t>(ends.in1 - a.begin());
}

// Names with the same start are neighbors in sorted order, so the longest start of `count` names is found by
// comparing the ends of a window.
std::string LongestStart(std::span<const std::string> sorted, size_t count)
{
    std::string_view longest;
    for (size_t first = 0; first + count <= sorted.size(); ++first)
    {
        const std::string_view name = sorted[first];
        const size_t length = LengthInCommon(name, sorted[first + count - 1]);
        if (length > longest.size())
            longest = name.substr(0, length);
    }
    return std::string(longest);
}

} // namespace

std::vector<std::string> SharedPrefixes(std::span<const std::string> names)
{
    names = names.first(std::min(names.size(), kNamesLooked));
    const auto most = static_cast<size_t>(std::lround(kNearlyAll * static_cast<double>(names.size())));
    if (most < kLeastNames)
        return {};
    std::vector<std::string> sorted(names.begin(), names.end());
    std::ranges::sort(sorted, {}, LowerCase);
    std::vector<std::string> prefixes;
    for (std::string start = LongestStart(sorted, most); !start.empty();)
    {
        prefixes.push_back(start);
        start.pop_back();
        start.resize(start.find_last_of(kSeparators) + 1); // 0 without a separator
    }
    return prefixes;
}

std::string CommonStart(std::span<const std::string_view> names)
{
    if (names.empty())
        return {};
    std::string_view start = names.front();
    for (const std::string_view name : names)
        start = start.substr(0, LengthInCommon(start, name));
    return std::string(start);
}

} // namespace gw
