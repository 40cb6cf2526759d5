#include "ConvertMotionFile.h"

#include "CFileConversion.h"

#include <algorithm>

namespace gw {

MotionFileResult ConvertMotionFile(const MotionFileJob& job)
{
    MotionFileResult result;
    CFileConversion conversion(job.dataFolder, job.choices,
                               [&](const Notice& notice) { result.notices.push_back(notice); });
    const auto isGood = [&] { return std::ranges::all_of(result.notices, &Notice::IsWarning); };
    result.written = conversion.LoadSource(job.source) && conversion.LoadTarget() &&
                     conversion.UseProfile(job.profile) && conversion.HasFrames() &&
                     conversion.Convert(true) && conversion.HasFrames() && isGood() &&
                     conversion.WriteResult(job.output) && isGood();
    return result;
}

} // namespace gw
