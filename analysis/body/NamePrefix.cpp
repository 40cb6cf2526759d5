// Finds the prefix that a program or rig puts before every joint name. A candidate is a start shared by many
// names; it is a prefix if more names can be interpreted without it than with it.

#include "NamePrefix.h"

#include "Text.h"

#include <algorithm>
#include <vector>

namespace gw {

namespace {

// Candidates are tried on every name, so both numbers are limited: a body's joints are among the first, and
// no prefix is longer than a short title.
constexpr size_t kNamesLooked = 256;
constexpr size_t kLongestPrefix = 32;
// A prefix is systematic: at least this many joints have it, and a third of those examined.
constexpr size_t kLeastNames = 8;

bool IsWordCharacter(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= '0' && c <= '9') || (c & 0x80) != 0;
}

bool IsUnderstood(const JointName& name)
{
    return name.word != EJointWord::None;
}

// Returns the starts shared by enough names, in order. In sorted order, names with the same start are
// neighbors, so it is enough to compare the ends of a window. A name that consists only of the start does not
// count.
std::vector<std::string> SharedStarts(std::span<const std::string_view> names)
{
    std::vector<std::string> sorted;
    sorted.reserve(names.size());
    for (const std::string_view name : names)
        sorted.push_back(LowerCase(name));
    std::ranges::sort(sorted);
    const size_t window = std::max(kLeastNames, names.size() / 3);
    std::vector<std::string> starts;
    for (size_t first = 0; first + window <= sorted.size(); ++first)
    {
        const std::string& name = sorted[first];
        const std::string& last = sorted[first + window - 1];
        for (size_t length = 1; length < std::min(name.size(), kLongestPrefix + 1); ++length)
        {
            const std::string_view start = std::string_view(name).substr(0, length);
            if (!last.starts_with(start))
                break;
            const bool isKnown =
                first > 0 && sorted[first - 1].size() > length && sorted[first - 1].starts_with(start);
            if (!isKnown)
                starts.emplace_back(start);
        }
    }
    return starts;
}

// Counts the names that can be interpreted without a prefix; 0 as soon as there must be fewer than `least`.
// What names mean that do not have it is known. Most candidates fail within the first few of the others.
size_t CountUnderstood(std::span<const std::string_view> names, std::span<const JointName> whole,
                       std::string_view prefix, size_t least)
{
    size_t count = names.size();
    std::vector<std::string_view> rests;
    for (size_t i = 0; i < names.size(); ++i)
    {
        const std::string_view rest = WithoutPrefix(names[i], prefix);
        if (rest.size() < names[i].size())
            rests.push_back(rest);
        else
            count -= IsUnderstood(whole[i]) ? 0 : 1;
    }
    for (size_t i = 0; i < rests.size() && count >= least; ++i)
        count -= IsUnderstood(ReadJointName(rests[i])) ? 0 : 1;
    return count >= least ? count : 0;
}

} // namespace

std::string_view WithoutNamespace(std::string_view name)
{
    const size_t colon = name.rfind(':');
    return colon == name.npos ? name : name.substr(colon + 1);
}

std::string FindNamePrefix(std::span<const std::string_view> names, std::span<const JointName> whole)
{
    names = names.first(std::min(names.size(), kNamesLooked));
    whole = whole.first(names.size());
    std::string best;
    auto most = static_cast<size_t>(std::ranges::count_if(whole, IsUnderstood));
    for (std::string& start : SharedStarts(names))
    {
        // A separator between prefix and name belongs to the prefix.
        const bool closes = !best.empty() && start.starts_with(best) && !IsWordCharacter(start.back());
        const size_t least = closes ? most : most + 1;
        const size_t count = CountUnderstood(names, whole, start, least);
        if (count < std::max<size_t>(least, 1))
            continue;
        most = count;
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
