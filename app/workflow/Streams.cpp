#include "Streams.h"

#include "Paths.h"
#include "StandardStreams.h"

namespace gw {

namespace {

constexpr std::string_view kContainerMark = "TKOrrin Version";
constexpr std::string_view kPackageMark = "MotionInfo"; // the name of a block at the start

struct ContentRow
{
    std::string_view mark;
    size_t within; ///< the mark lies in this many bytes
    std::string_view extension;
};
constexpr size_t kAnywhere = size_t{1} << 16;
constexpr ContentRow kContents[] = {
    {kContainerMark,            32,        ".orn" },
    {"glTF",                    4,         ".glb" },
    {"VersionNumber",           24,        ".chb" },
    {"FBX",                     64,        ".fbx" },
    {"<COLLADA",                kAnywhere, ".dae" },
    {"[SegmentNames&Hierarchy", kAnywhere, ".htr" },
    {"HIERARCHY\n",             kAnywhere, ".bvh" },
    {"HIERARCHY\r",             kAnywhere, ".bvh" },
    {"HIERARCHY ",              kAnywhere, ".bvh" },
    {"[HEADER]",                kAnywhere, ".cha" },
    {"\"asset\"",               kAnywhere, ".gltf"},
};

} // namespace

bool IsStream(const std::string& path)
{
    return path == kStandardStream || IsStreamPath(path);
}

bool IsStandardOutput(const std::string& path)
{
    return path == kStandardStream || IsStandardOutputPath(path);
}

std::string InFolder(const std::string& output, const std::string& source, std::string_view extension)
{
    const bool isFolder = output.ends_with('/') || FolderExists(output);
    return isFolder ? WithSeparator(output) + StemOf(source) + std::string(extension) : output;
}

std::string StemOf(const std::string& source)
{
    return source == kStandardStream ? "stdin" : SplitPath(source).stem;
}

std::string_view ExtensionOfContent(std::string_view start)
{
    if (start.starts_with(kContainerMark) && start.find(kPackageMark) != start.npos)
        return ".Kinetra";
    for (const ContentRow& row : kContents)
    {
        if (start.substr(0, row.within).find(row.mark) != start.npos)
            return row.extension;
    }
    return {};
}

} // namespace gw
