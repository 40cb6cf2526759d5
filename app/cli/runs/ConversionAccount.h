#pragma once

#include "ChooseProfile.h"
#include "ConvertFile.h"
#include "ConvertedMotion.h"
#include "ProfileFit.h"

#include <cstdio>
#include <optional>
#include <string>

namespace gw {

class CShellNotices;

/// The facts that are reported about a conversion.
struct ConversionAccount
{
    EConversion outcome = EConversion::Failed;
    std::string profile;
    std::string profilePath; ///< empty for a draft that is not kept
    int frames = 0;
    bool drafted = false;    ///< the profile was drafted for the source's skeleton
    std::string draftDigits; ///< hash of a kept draft
    std::string mended;      ///< what was repaired in the source; empty if nothing was
    std::optional<CProfileFit> misfit;
    std::optional<MeasuredConversion> check;
    std::optional<MeasuredConversion> plainCheck;  ///< for the same motion without options
    std::optional<MeasuredConversion> betterCheck; ///< for the same motion with --align --faithful
    /// no value if the profile was named or drafted, or is an original stock one
    std::optional<ProfileChoice> chosen;
    const char* whySkipped = "the output exists";
};

/// Prints a conversion's result, if it is to be told, and writes it to the record.
void TellAccount(const ShellOptions& options, const ConversionJob& job, const ConversionAccount& account,
                 const CShellNotices& notices, std::FILE* record);

} // namespace gw
