// Runs the command as users do: any file must produce a result, or a clear failure and no file.

#include "CommandTable.h"
#include "FuzzTarget.h"
#include "Paths.h"

#include <cstdint>
#include <filesystem>

namespace gw {

namespace {

// The first byte of an input is not part of the file; it selects the conversion options.
enum EWay : uint8_t
{
    kContainer = 1,
    kPackaged = 2,
    kPlainFeet = 4,
    kAligned = 8,
    kKeptFaithful = 16,
    kChecked = 32,
    kReplacing = 64,
};

bool LeavesOnly(const std::string& folder, size_t fileCount)
{
    const std::filesystem::directory_iterator files(folder);
    return static_cast<size_t>(std::distance(begin(files), end(files))) <= fileCount;
}

} // namespace

void FuzzOne(std::span<const std::byte> input)
{
    if (input.empty())
        return;
    const auto way = static_cast<uint8_t>(input.front());
    ShellOptions options;
    options.files = {ScratchFile(way & kContainer ? "in.orn" : "in.bvh", input.subspan(1))};
    options.output = ScratchPath(way & kPackaged ? "out.Kinetra" : "out.htr");
    options.dataFolder = GAITWRIGHT_ASSETS;
    options.noLegs = way & kPlainFeet;
    options.align = way & kAligned;
    options.faithful = way & kKeptFaithful;
    options.check = way & kChecked;
    options.force = way & kReplacing;
    options.quiet = true;
    const EExit exit = RunConvert(options);
    Require(FileExists(options.output) == (exit == EExit::Done), "a conversion answers what it leaves");
    DeleteFile(options.output);
    DeleteFile(options.files[0]);
    DeleteFile(ScratchPath("ImageLoadFailed.txt"));
    Require(LeavesOnly(ScratchPath(""), 0), "a conversion leaves no temporary");
}

} // namespace gw
