#include "ProfileNames.h"

#include "Numbers.h"
#include "Text.h"

#include <algorithm>

namespace gw {

namespace {

using Names = std::vector<std::string>;

// As many digits as can be counted up without leaving 32 bits.
constexpr size_t kDigitLimit = 9;

// Cuts "(7)" off the end of a name and answers 7; 0 for a name that ends otherwise.
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

// A long name gives up letters for the number, since a name over the limit would be refused as a new one
// later.
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
    // Each number gives another name, so at most one more than there are names is tried.
    do
        next = Numbered(base, ++number);
    while (IsNameInUse(next, inUse));
    return next;
}

} // namespace gw
