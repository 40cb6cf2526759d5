#include "LanguageCode.h"

#include "CPlatform.h"
#include "Text.h"

namespace gw {

namespace {

constexpr uint32_t kSimplifiedChinese = 2052;

constexpr struct
{
    uint32_t m_uiPrimary;
    std::string_view m_kCode;
} kCodes[] = {
    {4,  "cht"},
    {7,  "deu"},
    {10, "esn"},
    {12, "fra"},
    {16, "ita"},
    {17, "jpn"},
    {18, "kor"},
    {22, "ptg"},
};

// Longer names come first, because a prefix is enough for a match.
constexpr struct
{
    std::string_view m_kName;
    uint32_t m_uiLocale;
} kLocales[] = {
    {"zh_CN", kSimplifiedChinese},
    {"zh",    1028              },
    {"de",    1031              },
    {"es",    1034              },
    {"fr",    1036              },
    {"it",    1040              },
    {"ja",    1041              },
    {"ko",    1042              },
    {"pt_BR", 1046              },
    {"pt",    2070              },
    {"en",    1033              },
};

// "pt" matches "pt_PT" and "pt.UTF-8", but not "pty".
bool Begins(std::string_view name, std::string_view beginning)
{
    if (!EqualNoCase(name.substr(0, beginning.size()), beginning))
        return false;
    return name.size() == beginning.size() ||
           std::string_view("_.@-").find(name[beginning.size()]) != std::string_view::npos;
}

} // namespace

std::string_view LanguageCode(uint32_t locale)
{
    if (locale == kSimplifiedChinese)
        return "chs";
    for (const auto& row : kCodes)
    {
        if (row.m_uiPrimary == PrimaryLanguage(locale))
            return row.m_kCode;
    }
    return "enu";
}

uint32_t LocaleOfName(std::string_view posixName)
{
    for (const auto& row : kLocales)
    {
        if (Begins(posixName, row.m_kName))
            return row.m_uiLocale;
    }
    return 0;
}

} // namespace gw
