#include "Remedy.h"

#include <algorithm>
#include <iterator>

namespace gw {

namespace {

struct Row
{
    std::string_view code;
    ERemedy remedy;
};

constexpr Row kRemedies[] = {
    {"rest-pose",       ERemedy::AlignRestPose},
    {"turned-at-rest",  ERemedy::AlignRestPose},
    {"doubled-offsets", ERemedy::AlignRestPose},
    {"not-y-up",        ERemedy::AlignRestPose},
    {"misfit",          ERemedy::UseMap       },
    {"no-profile",      ERemedy::UseMap       },
    {"no-root-row",     ERemedy::UseMap       },
    {"no-root-source",  ERemedy::UseMap       },
    {"no-body",         ERemedy::UseMap       },
};

} // namespace

ERemedy RemedyOf(std::string_view noticeCode)
{
    const auto* const found = std::ranges::find(kRemedies, noticeCode, &Row::code);
    return found == std::end(kRemedies) ? ERemedy::None : found->remedy;
}

} // namespace gw
