#include "CMotionFile.h"
#include "CommandTable.h"
#include "Notice.h"
#include "Output.h"
#include "Paths.h"
#include "TKBVHStream.h"
#include "Text.h"
#include "Words.h"

#include <cmath>

namespace gw {

namespace {

EExit Fail(const std::string& path, const Finding& failure)
{
    SayFailure(path, failure);
    return EExit::Failed;
}

bool CanTranscode(const ShellOptions& options)
{
    const std::string& source = options.files[0];
    const std::string& output = options.files[1];
    if (HasExtension(output, ".bvh"))
    {
        if (options.frameScale == 1.0f)
            return true;
        SayError("--frame-scale works only for .htr output; a .bvh is written frame by frame");
        return false;
    }
    if (HasExtension(output, ".htr") && HasExtension(source, ".htr"))
        return true;
    SayError(Printable(output) + ": an .htr can be written as .htr or .bvh, any other motion only as .bvh; "
                                 "use 'gaitwright convert' to make an .htr");
    return false;
}

// A .bvh is written without the last frame, and its frame time has six decimals.
const char* WhyNoBVH(const CMotionFile& motion)
{
    constexpr float kLeastFrameTime = 0.0000005f;
    if (motion.GetLastFrame() <= -1.0f)
        return "the motion has no frames, so there is nothing to write";
    if (!(motion.GetFrequency() >= kLeastFrameTime) || !std::isfinite(motion.GetFrequency()))
        return "the frame time is 0, or too small for the six digits of a .bvh, so the rate would be lost";
    return nullptr;
}

} // namespace

EExit RunTranscode(const ShellOptions& options)
{
    const std::string& source = options.files[0];
    const std::string& output = options.files[1];
    if (!CanTranscode(options))
        return EExit::Usage;
    if (!MayWrite(options, output))
        return EExit::Failed;
    CMotionFile motion;
    if (!motion.Load(source))
        return Fail(source, motion.Record().Failure());
    SayWarnings(options, source, motion.Record());
    if (HasExtension(output, ".htr"))
    {
        if (!motion.Save(output, options.frameScale))
            return Fail(output, motion.Record().Failure());
        return TellWritten(options, source, output);
    }
    if (const char* const words = WhyNoBVH(motion))
    {
        SayNotice(options, MakeNotice(source, "no-bvh", words));
        return EExit::Failed;
    }
    TKBVHStream stream(motion);
    if (!stream.WriteFile(output))
        return Fail(output, stream.Record().Failure());
    return TellWritten(options, source, output);
}

} // namespace gw
