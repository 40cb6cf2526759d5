#include "BodyPaths.h"
#include "CMotionFile.h"
#include "COutputFile.h"
#include "CommandTable.h"
#include "FindBody.h"
#include "GlbFile.h"
#include "MotionFacts.h"
#include "Notice.h"
#include "Output.h"
#include "PackagedMotion.h"
#include "Paths.h"
#include "Streams.h"
#include "TKBVHStream.h"
#include "Text.h"
#include "UpAxis.h"
#include "Words.h"

#include <cmath>

namespace gw {

namespace {

EExit Fail(const std::string& path, const Finding& failure)
{
    SayFailure(path, failure);
    return EExit::Failed;
}

// Returns the output, or for a stream a name with the extension of its format.
std::string OutputName(const ShellOptions& options)
{
    const std::string& output = options.files[1];
    return IsStream(output) && !options.format.empty() ? '.' + options.format : output;
}

bool IsHTR(const std::string& source)
{
    return HasExtension(source, ".htr") || HasExtension(source, ".Kinetra") || IsStream(source);
}

bool CanTranscode(const ShellOptions& options)
{
    const std::string& source = options.files[0];
    const std::string output = OutputName(options);
    if (FolderExists(output))
        return Refuse(Printable(output) + ": a result in a folder needs --format");
    if (HasExtension(output, ".bvh") || HasExtension(output, ".glb"))
    {
        if (options.frameScale == 1.0f)
            return true;
        SayError("--frame-scale works only for .htr output; other formats are written frame by frame");
        return false;
    }
    if (HasExtension(output, ".htr") && IsHTR(source))
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

Vec3 UpAxisOf(const CMotionFile& motion)
{
    return FindUpAxis(FindBody(*motion.motionRoot).body, motion.GetFrequency(), motion.GetKeyCount());
}

// Writes the file by its extension. If that fails, records the reason and returns false.
bool Write(const ShellOptions& options, CMotionFile& motion, const std::string& path, CFailureRecord& record)
{
    if (HasExtension(path, ".htr"))
        return motion.Save(path, options.frameScale) || record.Fail(motion.Record().Failure());
    if (HasExtension(path, ".glb"))
        return SaveGlb(motion, MetersPerUnit(motion), path, record, UpAxisOf(motion));
    TKBVHStream stream(motion);
    return stream.WriteFile(path) || record.Fail(stream.Record().Failure());
}

} // namespace

EExit RunTranscode(const ShellOptions& options)
{
    const std::string& source = options.files[0];
    const std::string& output = options.files[1];
    if (!CanTranscode(options))
        return EExit::Usage;
    COutputFile file;
    CMotionFile motion;
    if (!file.Open(options, output, SplitPath(OutputName(options)).extension) ||
        !LoadMotion(options, source, options.rate, motion))
        return EExit::Failed;
    SayRateOfResult(options, source, motion);
    const char* const words = HasExtension(file.Path(), ".bvh") ? WhyNoBVH(motion) : nullptr;
    if (words)
    {
        SayNotice(options, MakeNotice(source, "no-bvh", words));
        return EExit::Failed;
    }
    CFailureRecord record;
    if (!Write(options, motion, file.Path(), record))
        return Fail(output, record.Failure());
    return file.DeliverOrSay() ? TellWritten(options, source, output) : EExit::Failed;
}

} // namespace gw
