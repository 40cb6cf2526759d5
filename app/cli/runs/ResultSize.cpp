#include "ResultSize.h"

#include "CBoneMapProfile.h"
#include "CKeyframeControl.h"
#include "COrrinStream.h"
#include "CShellContent.h"
#include "ConvertFile.h"
#include "Paths.h"
#include "Skeleton.h"
#include "SourceTiming.h"
#include "Words.h"

#include <algorithm>
#include <cmath>
#include <cstdio>

namespace gw {

namespace {

constexpr double kSavedRate = 120.0; // rows per second of a result, in terms of the profile's rate
// Seven numbers of at least eight characters ("0.000000"), each behind a separator, and a line end.
constexpr double kLeastRowBytes = 7 * 9 + 1;

// The characters of the row numbers from 1 to a count.
double NumberBytes(double rowCount)
{
    double bytes = 0.0;
    for (double first = 1.0; first <= rowCount; first *= 10.0)
        bytes += rowCount - first + 1.0; // all rows from here have one digit more
    return bytes;
}

} // namespace

std::optional<CReport> WhyTooLarge(const CShellContent& content, const CConversionJob& job)
{
    const CKeyframeControl* const track = ConversionTrack(content.SourceRoot());
    CNode* const skeleton = content.ResultMotion().restRoot.Get();
    const int rate = content.Profile() ? content.Profile()->GetFrameRate() : 0;
    if (!HasExtension(job.output, ".Kinetra") || !track || !skeleton || rate <= 0)
        return std::nullopt;
    const double frames = std::floor(std::max(static_cast<double>(track->m_fEndTime), -1.0)) + 1.0;
    const double rows = std::floor(frames * kSavedRate / rate);
    const auto bones = static_cast<double>(NodesOf(*skeleton).size());
    const double bytes = bones * (rows * kLeastRowBytes + NumberBytes(rows));
    if (!(bytes > static_cast<double>(kContainerBytesLimit)))
        return std::nullopt;
    char words[256];
    std::snprintf(
        words, sizeof words,
        "the result would take at least %.1f GiB (%.0f rows for each of %.0f bones), and a .Kinetra "
        "must be smaller than 2 GiB; split the motion, or write an .htr, which has no such limit",
        bytes / 1073741824.0, rows, bones);
    return ShellFailure(job.source, "too-large", words);
}

} // namespace gw
