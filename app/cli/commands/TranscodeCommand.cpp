#include "BodyPaths.h"
#include "CMotionFile.h"
#include "CommandTable.h"
#include "FindBody.h"
#include "GlbFile.h"
#include "MotionFacts.h"
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
    if (HasExtension(output, ".bvh") || HasExtension(output, ".glb"))
    {
        if (options.frameScale == 1.0f)
            return true;
        SayError("--frame-scale works only for .htr output; other formats are written frame by frame");
        return false;
    }
    if (HasExtension(output, ".htr") && HasExtension(source, ".htr"))
        return true;
    SayError(Printable(output) +
             ": an .htr can be written as .htr, .bvh or .glb, any other motion as .bvh or "
             ".glb; use 'gaitwright convert' to make an .htr");
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

// The file's own unit, or the one that the body's legs suggest.
double MetersPerUnit(const CMotionFile& motion)
{
    const double unit = motion.imported.unitMeters;
    return unit > 0.0 ? unit : MetersOfUnit(RestLegLength(FindBody(*motion.motionRoot).body));
}

EExit WriteAsGlb(const ShellOptions& options, const CMotionFile& motion)
{
    const std::string& output = options.files[1];
    CFailureRecord record;
    if (!SaveGlb(motion, MetersPerUnit(motion), output, record))
        return Fail(output, record.Failure());
    return TellWritten(options, options.files[0], output);
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
    if (HasExtension(output, ".glb"))
        return WriteAsGlb(options, motion);
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
