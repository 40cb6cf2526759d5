#include "NoticeKinds.h"

#include "FindingWords.h"
#include "Notice.h"

#include <algorithm>
#include <string_view>

namespace gw {

namespace {

struct KindRow
{
    std::string_view code;
    std::string_view words;
};

// Codes that are not those of findings.
constexpr KindRow kKinds[] = {
    {"misfit",            "no installed profile fits"                                        },
    {"doubtful",          "the best-matching profile is doubtful"                            },
    {"doubt",             "something speaks against the chosen profile"                      },
    {"rate",              "no profile can have the source's frame rate"                      },
    {"exists",            "the output exists (--force replaces it)"                          },
    {"folder",            "the output is a folder"                                           },
    {"changed",           "the output was changed after an earlier run (--force replaces it)"},
    {"crashed",           "the conversion crashed"                                           },
    {"time-limit",        "the time limit was reached"                                       },
    {"memory",            "there is not enough memory"                                       },
    {"dead-link",         "a link to a file that does not exist"                             },
    {"unreadable-folder", "a folder that cannot be read"                                     },
    {"out-of-range",      "a number of the profile is out of range"                          },
};

} // namespace

std::string KindWords(const Notice& notice)
{
    const auto row = std::ranges::find(kKinds, notice.code, &KindRow::code);
    if (row != std::end(kKinds))
        return std::string(row->words);
    for (int reason = 0; reason <= static_cast<int>(EFailure::TurnedAtRest); ++reason)
    {
        const Finding finding{.reason = static_cast<EFailure>(reason)};
        if (FindingCode(finding) == notice.code)
            return FindingWords({}, finding);
    }
    return notice.words.substr(0, notice.words.find('\n'));
}

} // namespace gw
