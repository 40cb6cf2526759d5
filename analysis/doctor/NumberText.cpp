#include "NumberText.h"

#include "Numbers.h"
#include "Text.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr std::string_view kBlankDelimiters = " \t\n";
constexpr std::string_view kOddNumberMark = ".#"; // "1.#IND", "-1.#QNAN", "1.#INF"

bool IsDigit(char c)
{
    return c >= '0' && c <= '9';
}

bool StandsBetweenDigits(std::string_view text, size_t at)
{
    return at > 0 && at + 1 < text.size() && IsDigit(text[at - 1]) && IsDigit(text[at + 1]);
}

} // namespace

size_t CountTokens(std::string_view text, std::string_view delimiters)
{
    size_t count = 0;
    while (!NextToken(text, delimiters).empty())
        ++count;
    return count;
}

bool HasDecimalCommas(std::string_view text, size_t valueCount)
{
    size_t comma = text.find(',');
    if (comma == text.npos)
        return false;
    for (; comma != text.npos; comma = text.find(',', comma + 1))
    {
        if (!StandsBetweenDigits(text, comma))
            return false;
    }
    return CountTokens(text, kBlankDelimiters) == valueCount;
}

std::string WithPoints(std::string_view text)
{
    std::string points(text);
    std::ranges::replace(points, ',', '.');
    return points;
}

std::optional<EFailure> FailureOfNumber(std::string_view token)
{
    ENumber kind;
    float value = 0.0f;
    ScanFloat(token, value, kind);
    if (kind == ENumber::Whole && std::isfinite(value))
        return std::nullopt;
    if (kind == ENumber::Unusual || kind == ENumber::Whole || token.find(kOddNumberMark) != token.npos)
        return EFailure::NaN;
    return EFailure::NotNumber;
}

} // namespace gw
