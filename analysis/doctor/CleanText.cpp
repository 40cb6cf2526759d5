// Lines and words are examined only after this step, so that a false blank, or a line end of another system,
// is one finding and not a hundred that follow from it.

#include "CleanText.h"

#include "CFindings.h"
#include "Text.h"

#include <algorithm>
#include <array>
#include <iterator>

namespace gw {

namespace {

// The start of every pointer file, without the address.
constexpr std::string_view kLfsBeginning = "version https://git-lfs";
constexpr size_t kStraysOfText = 8; // a text can contain this many, plus one per kBytesPerStray
constexpr size_t kBytesPerStray = 64;

// Characters that programs and text editors leave behind, and what was meant.
struct StrayRow
{
    std::string_view what;
    std::string_view bytes;
    std::string_view instead;
};

constexpr StrayRow kStrays[] = {
    {"U+00A0 no-break space",   "\xc2\xa0",     " "},
    {"U+FEFF byte order mark",  "\xef\xbb\xbf", "" },
    {"U+200B zero width space", "\xe2\x80\x8b", "" },
    {"U+2009 thin space",       "\xe2\x80\x89", " "},
    {"U+202F narrow space",     "\xe2\x80\xaf", " "},
    {"U+2212 minus sign",       "\xe2\x88\x92", "-"},
    {"U+2028 line separator",   "\xe2\x80\xa8", " "},
};

bool IsControl(char c)
{
    const auto code = static_cast<unsigned char>(c);
    return (code < 0x20 && c != '\t' && c != '\n' && c != '\r') || code == 0x7f;
}

// Marks the bytes that may be wrong, so that all others cost one look-up.
constexpr auto kIsSuspect = [] {
    std::array<bool, 256> suspect{};
    for (size_t code = 0; code < 0x20; ++code)
        suspect[code] = code != '\t' && code != '\n';
    suspect[0x7f] = true;
    for (const StrayRow& row : kStrays)
        suspect[static_cast<unsigned char>(row.bytes.front())] = true;
    return suspect;
}();

bool IsSuspect(char c)
{
    return kIsSuspect[static_cast<unsigned char>(c)];
}

bool IsText(std::string_view text)
{
    const bool wide = text.starts_with("\xff\xfe") || text.starts_with("\xfe\xff");
    const auto strays = static_cast<size_t>(std::ranges::count_if(text, IsControl));
    return !wide && strays <= kStraysOfText + text.size() / kBytesPerStray;
}

class CCleaner
{
public:
    CCleaner(std::string_view text, std::string& clean, CFindings& findings)
        : m_kRest(text), m_kText(text), clean_(clean), findings_(findings),
          m_bLineFeeds(text.find('\n') != text.npos)
    {
    }

    std::string_view Run()
    {
        CutByteOrderMark();
        while (!m_kRest.empty())
        {
            const auto suspect = std::ranges::find_if(m_kRest, IsSuspect);
            Keep(static_cast<size_t>(suspect - m_kRest.begin()));
            if (!m_kRest.empty())
                Judge();
        }
        return m_bChanged ? clean_ : m_kText;
    }

private:
    void CutByteOrderMark()
    {
        const size_t length = m_kRest.size() - SkipByteOrderMark(m_kRest).size();
        if (length > 0)
            Replace(EFailure::ByteOrderMark, length, "", "");
    }
    void Judge()
    {
        if (m_kRest.front() == '\r')
            return JudgeReturn();
        if (IsControl(m_kRest.front()))
            return JudgeControl();
        const auto isHere = [this](const StrayRow& row) { return m_kRest.starts_with(row.bytes); };
        const auto* const stray = std::ranges::find_if(kStrays, isHere);
        if (stray == std::end(kStrays))
            return Keep(1);
        Replace(EFailure::StrayCharacter, stray->bytes.size(), stray->instead, stray->what);
    }
    // If the whole text has no line feed, these are its line ends. Otherwise a return is a blank at best, and
    // before a complete line end it comes from converting line ends twice.
    void JudgeReturn()
    {
        if (m_kRest.starts_with("\r\n"))
            return Keep(2);
        const bool again = m_kRest.starts_with("\r\r\n");
        Replace(EFailure::CarriageReturn, 1, m_bLineFeeds ? (again ? "" : " ") : "\n", "");
    }
    void JudgeControl()
    {
        const size_t length =
            std::min(m_kRest.find_first_not_of(m_kRest.front()), m_kRest.size()); // one finding for a run
        Replace(EFailure::StrayCharacter, length, length == m_kRest.size() ? "" : " ",
                Printable(m_kRest.substr(0, 1)));
    }

    void Keep(size_t length)
    {
        const std::string_view kept = m_kRest.substr(0, length);
        m_uiLine += static_cast<size_t>(std::ranges::count(kept, '\n'));
        if (m_bChanged)
            clean_ += kept;
        m_kRest.remove_prefix(length);
    }
    void Replace(EFailure fault, size_t length, std::string_view instead, std::string_view what)
    {
        if (!m_bChanged)
            clean_.assign(m_kText.substr(0, m_kText.size() - m_kRest.size()));
        m_bChanged = true;
        clean_ += instead;
        findings_.Add(fault, m_uiLine, std::string(what));
        m_uiLine += instead == "\n";
        m_kRest.remove_prefix(length);
    }

    std::string_view m_kRest;
    std::string_view m_kText;
    std::string& clean_;
    CFindings& findings_;
    bool m_bLineFeeds;
    size_t m_uiLine = 1;
    bool m_bChanged = false;
};

} // namespace

bool IsLfsPointer(std::string_view text)
{
    return text.starts_with(kLfsBeginning);
}

std::string_view CleanText(std::string_view text, std::string& clean, CFindings& findings)
{
    if (IsLfsPointer(text))
    {
        findings.Add(EFailure::LfsPointer, 1);
        return {};
    }
    if (!IsText(text))
    {
        findings.Add(EFailure::NotText, 0);
        return {};
    }
    clean.clear();
    return CCleaner(text, clean, findings).Run();
}

} // namespace gw
