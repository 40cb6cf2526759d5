#include "ProfileNames.h"

#include "Numbers.h"
#include "Text.h"

#include <algorithm>

namespace gw {

namespace {

using Names = std::vector<std::string>;

// As many digits as can be incremented within 32 bits.
constexpr size_t kDigitLimit = 9;

// Removes "(7)" from the end of a name and returns 7; 0 if there is no number.
int CutNumber(std::string_view& name)
{
    const size_t open = name.rfind('(');
    if (open == name.npos || !name.ends_with(')'))
        return 0;
    const std::string_view digits = name.substr(open + 1, name.size() - open - 2);
    const auto isDigit = [](char c) { return c >= '0' && c <= '9'; };
    if (digits.empty() || digits.size() > kDigitLimit || !std::ranges::all_of(digits, isDigit))
        return 0;
    name = name.substr(0, open);
    return ParseInt(digits);
}

// A long name is shortened to make room for the number, because a name over the limit would later be refused.
std::string Numbered(std::string_view base, int number)
{
    const std::string ending = '(' + std::to_string(number) + ')';
    return std::string(FirstCharacters(base, kProfileNameLimit - ending.size())) + ending;
}

} // namespace

std::string_view FirstCharacters(std::string_view text, size_t count)
{
    const auto begins = [](char c) { return (static_cast<unsigned char>(c) & 0xc0) != 0x80; };
    for (size_t i = 0; i < text.size(); ++i)
    {
        if (begins(text[i]) && count-- == 0)
            return text.substr(0, i);
    }
    return text;
}

bool IsNameInUse(std::string_view name, const Names* inUse)
{
    const auto same = [name = CutTrailing(name)](const std::string& other) {
        return EqualNoCase(CutTrailing(other), name);
    };
    return inUse && std::ranges::any_of(*inUse, same);
}

std::string NextFreeName(std::string_view name, const Names* inUse)
{
    if (!IsNameInUse(name, inUse))
        return std::string(name);
    std::string_view base = CutTrailing(name);
    int number = CutNumber(base);
    std::string next;
    // Each number yields another name, so this ends after at most one more try than there are names.
    do
        next = Numbered(base, ++number);
    while (IsNameInUse(next, inUse));
    return next;
}

} // namespace gw
