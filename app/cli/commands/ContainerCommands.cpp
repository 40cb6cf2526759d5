#include "CCustomData.h"
#include "COrrinStream.h"
#include "COutputFile.h"
#include "CSafeFile.h"
#include "CommandTable.h"
#include "OpenSource.h"
#include "Output.h"
#include "PackageBlocks.h"
#include "PackagedMotion.h"
#include "Packaging.h"
#include "Paths.h"
#include "Streams.h"
#include "Text.h"
#include "Words.h"

namespace gw {

namespace {

constexpr float kPackageSixty = 60.0f; // stored after the rate in every package

EExit Fail(const std::string& path, Finding failure)
{
    failure.name.clear();
    SayFailure(path, failure);
    return EExit::Failed;
}

// Reads a container, which may be a stream. Returns false, after printing the reason, unless it is complete.
bool LoadContainer(COrrinStream& scene, const std::string& path)
{
    CSourceFile source;
    if (!OpenSource(source, path, EPackage::Kept))
        return false;
    return LoadWhole(scene, source.Path(), path);
}

bool WriteWhole(const std::string& path, std::span<const std::byte> bytes)
{
    CSafeFile file;
    return file.Open(path) && file.Write(bytes) && file.Commit();
}

} // namespace

EExit RunResave(const ShellOptions& options)
{
    const std::string& source = options.files[0];
    const std::string& output = options.files[1];
    COrrinStream scene;
    COutputFile file;
    if (!file.Open(options, output, ".orn") || !LoadContainer(scene, source))
        return EExit::Failed;
    SayWarnings(options, source, scene.Record());
    if (!scene.SaveFile(file.Path()))
        return Fail(output, scene.Record().Failure());
    return file.DeliverOrSay() ? TellWritten(options, source, output) : EExit::Failed;
}

EExit RunExtract(const ShellOptions& options)
{
    const std::string& source = options.files[0];
    COrrinStream scene;
    if (!LoadContainer(scene, source))
        return EExit::Failed;
    const PackageBlocks blocks = FindPackage(scene);
    if (!blocks.file)
    {
        SayError(source, "not-a-package",
                 "this is not a Kinetra file: its roots must include the data blocks "
                 "\"MotionInfo\" and \"MotionFile\"");
        return EExit::Failed;
    }
    PackageFacts facts;
    const std::string inside = ReadPackageFacts(*blocks.info, facts) ? FormatExtension(facts.format) : "";
    const std::string output = InFolder(options.output, source, inside.empty() ? ".htr" : inside);
    COutputFile file;
    if (!file.Open(options, output, ".htr"))
        return EExit::Failed;
    if (!inside.empty() && !HasExtension(file.Path(), inside))
        SayWarning(options, Printable(source) + " contains an " + inside + " file");
    if (!WriteWhole(file.Path(), blocks.file->Data()))
    {
        SayNotWritten(output);
        return EExit::Failed;
    }
    return file.DeliverOrSay() ? TellWritten(options, source, output) : EExit::Failed;
}

EExit RunPackage(const ShellOptions& options)
{
    const std::string& source = options.files[0];
    const std::string& output = options.files[1];
    COutputFile file;
    CSourceFile motion;
    if (!file.Open(options, output, ".Kinetra") || !OpenSource(motion, source, EPackage::Kept))
        return EExit::Failed;
    CFailureRecord record;
    PackageMotion(motion.Path(), file.Path(), options.rate, kPackageSixty, record);
    if (const Finding& failure = record.Failure())
        return Fail(failure.name.empty() ? output : failure.name, failure);
    return file.DeliverOrSay() ? TellWritten(options, source, output) : EExit::Failed;
}

} // namespace gw
