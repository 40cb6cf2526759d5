// Text helpers for the readers: tokens, lines, ASCII case, UTF-8 for printing, and the most similar name.

#include "Text.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <numeric>

namespace gw {

namespace {

// The characters that sscanf and the C locale treat as blank.
constexpr std::string_view kBlanks = " \t\n\v\f\r";

char Lower(char c)
{
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c + ('a' - 'A')) : c;
}

char Upper(char c)
{
    return c >= 'a' && c <= 'z' ? static_cast<char>(c - ('a' - 'A')) : c;
}

// A set of bytes with one table look-up per character.
class CByteSet
{
public:
    explicit constexpr CByteSet(std::string_view members)
    {
        for (const char c : members)
            m_abHas[static_cast<unsigned char>(c)] = true;
    }
    bool Has(char c) const { return m_abHas[static_cast<unsigned char>(c)]; }

private:
    std::array<bool, 256> m_abHas = {};
};

// Up to half of a skeleton's text is indentation, so the compiler makes the usual sets.
constexpr CByteSet kTokenDelimiterSet(kTokenDelimiters);
constexpr CByteSet kBlankSet(kBlanks);

// Checks the second byte of a UTF-8 sequence: rejects overlong forms, surrogates, and code points beyond the
// last one.
bool MayFollow(unsigned char lead, unsigned char second)
{
    const unsigned char least = lead == 0xe0 ? 0xa0 : lead == 0xf0 ? 0x90 : 0x80;
    const unsigned char most = lead == 0xed ? 0x9f : lead == 0xf4 ? 0x8f : 0xbf;
    return least <= second && second <= most;
}

// Returns the length of the UTF-8 character at the front of a text, or 0 for a stray or truncated sequence.
size_t CharacterLength(std::string_view text)
{
    const auto lead = static_cast<unsigned char>(text.front());
    size_t length = 0;
    if (lead < 0x80)
        return 1;
    if (lead >= 0xc2 && lead < 0xe0)
        length = 2;
    else if (lead >= 0xe0 && lead < 0xf0)
        length = 3;
    else if (lead >= 0xf0 && lead < 0xf5)
        length = 4;
    if (length == 0 || text.size() < length || !MayFollow(lead, static_cast<unsigned char>(text[1])))
        return 0;
    const auto follows = [](char c) { return (static_cast<unsigned char>(c) & 0xc0) == 0x80; };
    return std::ranges::all_of(text.substr(1, length - 1), follows) ? length : 0;
}

// ASCII control characters, and U+0080 to U+009F, which terminals obey too.
bool IsControl(std::string_view character)
{
    const auto lead = static_cast<unsigned char>(character.front());
    if (character.size() == 1)
        return lead < 0x20 || lead == 0x7f;
    return lead == 0xc2 && static_cast<unsigned char>(character[1]) < 0xa0;
}

void AppendEscaped(std::string& out, std::string_view bytes)
{
    constexpr char kHex[] = "0123456789abcdef";
    for (const char c : bytes)
    {
        const auto byte = static_cast<unsigned char>(c);
        out += {'\\', 'x', kHex[byte >> 4], kHex[byte & 15]};
    }
}

// Returns the minimum number of insertions, deletions and substitutions (Wagner and Fischer 1974), row by
// row.
size_t EditDistance(std::string_view a, std::string_view b)
{
    std::vector<size_t> row(b.size() + 1);
    std::iota(row.begin(), row.end(), size_t{0});
    for (size_t i = 0; i < a.size(); ++i)
    {
        size_t diagonal = row[0];
        row[0] = i + 1;
        for (size_t j = 0; j < b.size(); ++j)
        {
            const size_t changed = diagonal + (Lower(a[i]) != Lower(b[j]));
            diagonal = row[j + 1];
            row[j + 1] = std::min({changed, diagonal + 1, row[j] + 1});
        }
    }
    return row.back();
}

std::string_view NextPart(std::string_view& rest, const CByteSet& separators)
{
    const auto separates = [&](char c) { return separators.Has(c); };
    const auto begin = std::ranges::find_if_not(rest, separates);
    const auto end = std::find_if(begin, rest.end(), separates);
    const std::string_view token(begin, end);
    rest = {end, rest.end()};
    return token;
}

} // namespace

bool EqualNoCase(std::string_view a, std::string_view b)
{
    return std::ranges::equal(a, b, {}, Lower, Lower);
}

std::string LowerCase(std::string_view text)
{
    std::string out(text);
    std::ranges::transform(out, out.begin(), Lower);
    return out;
}

std::string UpperCase(std::string_view text)
{
    std::string out(text);
    std::ranges::transform(out, out.begin(), Upper);
    return out;
}

std::string_view CutTrailing(std::string_view text)
{
    return text.substr(0, text.find_last_not_of(kBlanks) + 1);
}

std::string_view NextToken(std::string_view& rest)
{
    return NextPart(rest, kTokenDelimiterSet);
}

std::string_view NextToken(std::string_view& rest, std::string_view delimiters)
{
    return NextPart(rest, CByteSet(delimiters));
}

std::string_view NextWord(std::string_view& rest)
{
    return NextPart(rest, kBlankSet);
}

bool NextLine(std::string_view& rest, std::string_view& line)
{
    if (rest.empty())
        return false;
    const size_t end = rest.find('\n');
    line = rest.substr(0, end);
    rest.remove_prefix(end == rest.npos ? rest.size() : end + 1);
    if (end != rest.npos && line.ends_with('\r'))
        line.remove_suffix(1);
    return true;
}

std::string_view SkipByteOrderMark(std::string_view text)
{
    constexpr std::string_view kMark = "\xef\xbb\xbf";
    return text.starts_with(kMark) ? text.substr(kMark.size()) : text;
}

std::string Printable(std::string_view text)
{
    std::string out;
    out.reserve(text.size());
    while (!text.empty())
    {
        const size_t length = CharacterLength(text);
        const std::string_view character = text.substr(0, std::max<size_t>(length, 1));
        if (length == 0 || IsControl(character))
            AppendEscaped(out, character);
        else
            out += character;
        text.remove_prefix(character.size());
    }
    return out;
}

std::string Quoted(std::string_view name)
{
    return '"' + Printable(name) + '"';
}

std::string NearestName(std::string_view name, const std::vector<std::string>& candidates)
{
    // The distance takes time proportional to the product of the lengths, and names come from files.
    constexpr size_t kLongestName = 64;
    if (name.empty() || name.size() > kLongestName)
        return {};
    // A third of the letters may differ: enough for a typo or a missing syllable, too few for a different
    // word.
    size_t limit = std::max<size_t>(name.size() / 3, 1) + 1;
    const std::string* nearest = nullptr;
    for (const std::string& candidate : candidates)
    {
        if (candidate.size() >= name.size() + limit || candidate.size() + limit <= name.size())
            continue;
        const size_t distance = EditDistance(name, candidate);
        if (distance < limit)
        {
            limit = distance;
            nearest = &candidate;
        }
    }
    return nearest ? *nearest : std::string();
}

} // namespace gw
