#include "CMotionFile.h"
#include "COutputFile.h"
#include "CommandTable.h"
#include "Notice.h"
#include "Output.h"
#include "PackagedMotion.h"
#include "Paths.h"
#include "Streams.h"
#include "Text.h"
#include "TranscodeFile.h"
#include "Words.h"

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
    if (!WriteTranscoded(motion, file.Path(), options.frameScale, record))
        return Fail(output, record.Failure());
    return file.DeliverOrSay() ? TellWritten(options, source, output) : EExit::Failed;
}

} // namespace gw
