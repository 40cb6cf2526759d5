#include "ResultSize.h"

#include "CFileConversion.h"
#include "COrrinStream.h"
#include "ConvertFile.h"
#include "Paths.h"
#include "ResultFile.h"
#include "Skeleton.h"
#include "Words.h"

#include <algorithm>
#include <cmath>
#include <cstdio>

namespace gw {

namespace {

// Seven numbers of at least eight characters ("0.000000"), each with a separator, and a line end.
constexpr double kLeastRowBytes = 7 * 9 + 1;

// Returns the total number of digits of all row numbers from 1 to a finite count.
double NumberBytes(double rowCount)
{
    double bytes = 0.0;
    double first = 1.0;
    while (first <= rowCount)
    {
        bytes += rowCount - first + 1.0; // all rows from here on have one more digit
        first *= 10.0;
    }
    return bytes;
}

} // namespace

std::optional<Notice> WhyTooLarge(const CFileConversion& conversion, const ConversionJob& job)
{
    CNode* const skeleton = conversion.Result().restRoot.Get();
    const int rate = conversion.Profile().frameRate;
    const double lastFrame = static_cast<double>(conversion.Timing().lastFrame);
    // A scene's motion can have no end, which the conversion itself refuses.
    if (!HasExtension(job.output, ".Kinetra") || !skeleton || rate <= 0 || !std::isfinite(lastFrame))
        return std::nullopt;
    const double frames = std::floor(std::max(lastFrame, -1.0)) + 1.0;
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
    return MakeNotice(job.source, "too-large", words);
}

} // namespace gw
