#include "CCustomData.h"
#include "COrrinStream.h"
#include "CSafeFile.h"
#include "CommandTable.h"
#include "Output.h"
#include "PackageBlocks.h"
#include "PackagedMotion.h"
#include "Packaging.h"
#include "Paths.h"
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
    if (!MayWrite(options, output) || !LoadWhole(scene, source))
        return EExit::Failed;
    SayWarnings(options, source, scene.Record());
    if (!scene.SaveFile(output))
        return Fail(output, scene.Record().Failure());
    return TellWritten(options, source, output);
}

EExit RunExtract(const ShellOptions& options)
{
    const std::string& source = options.files[0];
    COrrinStream scene;
    if (!MayWrite(options, options.output) || !LoadWhole(scene, source))
        return EExit::Failed;
    const PackageBlocks blocks = FindPackage(scene);
    if (!blocks.file)
    {
        SayError(Printable(source) + ": this is not a Kinetra file: its roots must include the data blocks "
                                     "\"MotionInfo\" and \"MotionFile\"");
        return EExit::Failed;
    }
    PackageFacts facts;
    const std::string inside = ReadPackageFacts(*blocks.info, facts) ? FormatExtension(facts.format) : "";
    if (!inside.empty() && !HasExtension(options.output, inside))
        SayWord(options, "warning: " + Printable(source) + " contains an " + inside + " file");
    if (!WriteWhole(options.output, blocks.file->Data()))
    {
        SayNotWritten(options.output);
        return EExit::Failed;
    }
    return TellWritten(options, source, options.output);
}

EExit RunPackage(const ShellOptions& options)
{
    const std::string& source = options.files[0];
    const std::string& output = options.files[1];
    if (!MayWrite(options, output))
        return EExit::Failed;
    CFailureRecord record;
    PackageMotion(source, output, options.rate, kPackageSixty, record);
    if (const Finding& failure = record.Failure())
        return Fail(failure.name.empty() ? output : failure.name, failure);
    return TellWritten(options, source, output);
}

} // namespace gw
