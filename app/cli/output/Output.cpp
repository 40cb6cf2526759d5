#include "Output.h"

#include "CJsonWriter.h"
#include "CSafeFile.h"
#include "Files.h"
#include "JsonStatus.h"
#include "NativePath.h"
#include "Paths.h"
#include "Streams.h"
#include "SystemError.h"
#include "Text.h"
#include "Words.h"

#include <cstdio>
#include <filesystem>

namespace gw {

namespace {

bool IsReadableFolder(const std::string& path)
{
    return ListFolder(path, [](const FolderEntry&) { return false; });
}

} // namespace

bool IsDecidedOnExisting(const ShellOptions& options)
{
    if (!options.force || !options.skipExisting)
        return true;
    SayError("--force and --skip-existing cannot be combined");
    return false;
}

bool IsTaken(const std::string& path)
{
    return FileExists(path) || FolderExists(path) || IsLink(path);
}

Notice UnreadableFolder(const std::string& path)
{
    const int error = IsReadableFolder(path) ? 0 : LastSystemError();
    return MakeNotice(path, "unreadable-folder", "the folder cannot be read" + SystemErrorWords(error));
}

std::optional<Notice> WhyNoSource(const std::string& path)
{
    if (FolderExists(path))
        return UnreadableFolder(path);
    if (!IsLink(path) || FileExists(path))
        return std::nullopt;
    std::error_code error;
    const std::string target = PathText(std::filesystem::read_symlink(NativePath(path), error));
    return MakeNotice(path, "dead-link", "a link to a file that does not exist: " + Quoted(target));
}

bool CanListFolder(const ShellOptions& options, const std::string& path)
{
    const bool isReadable = IsReadableFolder(path);
    if (!isReadable)
        SayNotice(options, UnreadableFolder(path));
    return isReadable;
}

std::optional<Notice> WhyNotWrite(const ShellOptions& options, const std::string& path)
{
    if (path == "-")
        return MakeNotice(path, "no-stream", "this cannot be written to standard output; name a file");
    if (FolderExists(path))
        return MakeNotice(path, "folder", "this is a folder; name the file to write");
    if (options.force)
        return std::nullopt;
    if (FileExists(path))
        return MakeNotice(path, "exists", "the file exists; --force replaces it");
    if (IsLink(path))
        return MakeNotice(path, "dangling-link",
                          "this is a link to a file that does not exist; --force writes that file");
    CSafeFile::KeepExisting(path);
    return std::nullopt;
}

bool MayWrite(const ShellOptions& options, const std::string& path)
{
    const std::optional<Notice> refusal = WhyNotWrite(options, path);
    if (refusal)
        SayNotice(options, *refusal);
    return !refusal;
}

void PrintResult(const ShellOptions& options, const std::string& output, const std::string& line)
{
    if (options.quiet)
        return;
    if (IsStandardOutput(output))
        SayWord(options, line);
    else
        std::puts(line.c_str());
}

EExit TellWritten(const ShellOptions& options, const std::string& source, const std::string& output)
{
    if (options.json)
    {
        CJsonWriter json(stdout);
        json.BeginObject();
        WriteStatus(json, "ok");
        json.Key("source").Text(source);
        json.Key("output").Text(output);
        json.EndObject();
        json.EndDocument();
    }
    else
    {
        PrintResult(options, output, Printable(source) + " -> " + Printable(output));
    }
    return EExit::Done;
}

} // namespace gw
