#include "LineParts.h"

#include "Text.h"

#include <algorithm>
#include <cstddef>

namespace gw {

namespace {

constexpr std::string_view kBehindBrace[] = {"", "{", "}", "OFFSET", "CHANNELS", "JOINT", "End", "ROOT"};

bool IsBrace(std::string_view token)
{
    return token == "{" || token == "}";
}

bool IsBraceAhead(std::string_view rest)
{
    if (!IsBrace(NextToken(rest)))
        return false;
    const std::string_view behind = NextToken(rest);
    return std::ranges::any_of(kBehindBrace,
                               [=](std::string_view word) { return EqualNoCase(word, behind); });
}

} // namespace

std::string_view NextPart(std::string_view& rest)
{
    std::string_view token = NextToken(rest);
    std::string_view part = token;
    while (!token.empty() && !IsBrace(part) && !IsBraceAhead(rest))
    {
        token = NextToken(rest);
        if (!token.empty())
            part = {part.data(), static_cast<size_t>(token.data() + token.size() - part.data())};
    }
    return part;
}

} // namespace gw
