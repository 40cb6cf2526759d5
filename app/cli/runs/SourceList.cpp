// Expands the files and folders of a command line into sources, each with the relative path that its result
// keeps below the output folder.

#include "SourceList.h"

#include "CMappedFile.h"
#include "Files.h"
#include "Paths.h"
#include "SourceTree.h"
#include "Streams.h"
#include "SystemError.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>
#include <cstdio>

namespace gw {

namespace {

// Components such as ".." have no equivalent below an output folder.
std::vector<std::string> Steps(const std::string& path)
{
    std::vector<std::string> steps;
    std::string_view rest = path;
    for (std::string_view step = NextToken(rest, kSystemSeparators); !step.empty();
         step = NextToken(rest, kSystemSeparators))
    {
        if (step != "." && step != "..")
            steps.emplace_back(step);
    }
    return steps;
}

std::string Joined(std::span<const std::string> steps)
{
    std::string path;
    for (const std::string& step : steps)
        path += (path.empty() ? "" : std::string(1, kPathSeparator)) + step;
    return path;
}

// Reads a list from standard input, or from a pipe.
bool ReadStream(const std::string& path, std::string& text)
{
    std::FILE* const stream =
        path == kStandardStream ? stdin : StreamOf(OpenFile(path, EOpen::ReadStream), "r");
    if (!stream)
        return false;
    constexpr size_t kLimit = size_t{1} << 30; // far above any list, and ends a stream without end
    char piece[65536];
    while (const size_t count = text.size() < kLimit ? std::fread(piece, 1, sizeof piece, stream) : 0)
        text.append(piece, count);
    const bool isRead = std::ferror(stream) == 0 && text.size() < kLimit;
    if (stream != stdin)
        std::fclose(stream);
    return isRead;
}

bool ReadList(const ShellOptions& options, std::vector<std::string>& paths)
{
    CMappedFile file;
    std::string input;
    const bool isInput = IsStream(options.filesFrom);
    if (isInput ? !ReadStream(options.filesFrom, input) : file.Open(options.filesFrom) != EFailure::None)
    {
        SayError(options.filesFrom, "unreadable-list", "the list cannot be read" + TakeSystemErrorWords());
        return false;
    }
    std::string_view rest = isInput ? std::string_view(input) : file.Text();
    std::string_view line;
    while (options.nullSeparated ? !(line = NextToken(rest, std::string_view("\0", 1))).empty()
                                 : NextLine(rest, line))
    {
        if (!line.empty())
            paths.emplace_back(line);
    }
    return true;
}

// A folder that cannot be read is listed in place of its sources, and so is a dead link; converting it then
// fails with a message.
void AddFolder(const std::string& folder, const std::string& below, const ShellOptions& options,
               std::span<const std::string_view> extensions, std::vector<RunSource>& sources)
{
    const SourceFolder tree = WalkFolder(folder, extensions, options.outputFolder);
    for (const std::string& file : tree.files)
        sources.push_back({WithSeparator(folder) + file, below + file});
    for (const std::string& link : tree.deadLinks)
        sources.push_back({WithSeparator(folder) + link, below + link});
    for (const std::string& unreadable : tree.unreadable)
        sources.push_back({unreadable, below + Joined(Steps(unreadable.substr(folder.size()))) + "folder"});
}

void AddListed(const std::vector<std::string>& paths, const ShellOptions& options,
               std::span<const std::string_view> extensions, std::vector<RunSource>& sources)
{
    std::vector<std::string> common;
    for (size_t i = 0; i < paths.size(); ++i)
    {
        std::vector<std::string> folder = Steps(paths[i]);
        if (!folder.empty())
            folder.pop_back();
        if (i == 0)
            common = folder;
        common.erase(std::ranges::mismatch(common, folder).in1, common.end());
    }
    for (const std::string& path : paths)
    {
        const std::vector<std::string> steps = Steps(path);
        const std::string below = Joined(std::span(steps).subspan(std::min(common.size(), steps.size())));
        if (FolderExists(path))
            AddFolder(path, WithSeparator(below), options, extensions, sources);
        else
            sources.push_back({path, below});
    }
}

} // namespace

bool ListSources(const ShellOptions& options, std::span<const std::string_view> extensions,
                 std::vector<RunSource>& sources)
{
    for (const std::string& file : options.files)
    {
        const PathParts parts = SplitPath(file);
        if (FolderExists(file))
            AddFolder(file, {}, options, extensions, sources);
        else
            sources.push_back({file, parts.stem + parts.extension});
    }
    std::vector<std::string> listed;
    if (!options.filesFrom.empty() && !ReadList(options, listed))
        return false;
    AddListed(listed, options, extensions, sources);
    return true;
}

std::string OutputOf(const std::string& folder, const RunSource& source, std::string_view extension)
{
    const PathParts parts = SplitPath(folder.empty() ? source.path : source.below);
    return WithSeparator(folder) + parts.folder + parts.stem + std::string(extension);
}

} // namespace gw
