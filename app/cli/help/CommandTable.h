#pragma once

#include "ShellOptions.h"

#include <cstddef>
#include <span>
#include <string_view>

namespace gw {

/// Options that a command can accept, one bit each.
enum EOption : uint64_t
{
    kOutput = 1ull << 0,
    kOutputFolder = 1ull << 1,
    kProfile = 1ull << 2,
    kJob = 1ull << 3,
    kFrame = 1ull << 4,
    kRate = 1ull << 5,
    kFrameScale = 1ull << 6,
    kNoLegs = 1ull << 7,
    kForce = 1ull << 8,
    kSkipExisting = 1ull << 9,
    kDryRun = 1ull << 10,
    kKeepGoing = 1ull << 11,
    kDataFolder = 1ull << 12,
    kJson = 1ull << 13,
    kQuiet = 1ull << 14,
    kWith = 1ull << 15,
    kStrip = 1ull << 16,
    kSize = 1ull << 17,
    kTime = 1ull << 18,
    kObjects = 1ull << 19,
    kAlign = 1ull << 20,
    kFaithful = 1ull << 21,
    kCheck = 1ull << 22,
    kHtml = 1ull << 23,
    kFix = 1ull << 24,
    kJobs = 1ull << 25,
    kFilesFrom = 1ull << 26,
    kNull = 1ull << 27,
    kResume = 1ull << 28,
    kReport = 1ull << 29,
    kTimeLimit = 1ull << 30,
    kShards = 1ull << 31,
    kShard = 1ull << 32,
    kNoHands = 1ull << 33,
    kDraft = 1ull << 34,
    kDrafts = 1ull << 35,
    kMend = 1ull << 36,
    kVerbose = 1ull << 37,
    kFormat = 1ull << 38,
    kFrames = 1ull << 39,
    kInPlace = 1ull << 40,
    kMirror = 1ull << 41,
    kClip = 1ull << 42,
    kListClips = 1ull << 43,
    kAll = 1ull << 44,
    kView = 1ull << 50,
    kBackground = 1ull << 51,
    kUpright = 1ull << 52,
    kAxes = 1ull << 53,
    kAnimate = 1ull << 54,
};

/// Options that control how a run works, but not what a source is converted to. All others are part of a
/// plan, and of what --resume compares: one too many there costs time, one too few would keep outdated
/// results.
inline constexpr uint64_t kHowToRun =
    kOutput | kOutputFolder | kForce | kSkipExisting | kDryRun | kKeepGoing | kDataFolder | kJson | kQuiet |
    kVerbose | kJobs | kFilesFrom | kNull | kResume | kReport | kTimeLimit | kShards | kShard | kFormat;

/// One command of the program.
struct ShellCommand
{
    std::string_view name;
    std::string_view operands; ///< as shown in the usage line: "IN OUT", "[SOURCE]", "SOURCE..."
    uint64_t options;          ///< bits of EOption, in addition to those of every command
    uint64_t required;         ///< the required ones
    EExit (*run)(const ShellOptions& options);
    std::string_view help; ///< the first line is shown in the list of commands
    std::string_view example;
    uint64_t choice; ///< exactly one of these is required; 0 for no such choice
};

/// Returns the minimum number of operands of a command.
size_t LeastOperands(const ShellCommand& command);
size_t MostOperands(const ShellCommand& command);

/// Returns the commands, in help order.
std::span<const ShellCommand> Commands();

// The commands. Each prints results to standard output and messages to standard error.
EExit RunConvert(const ShellOptions& options);
EExit RunBatchFolder(const ShellOptions& options);
EExit RunPlan(const ShellOptions& options);
EExit RunShard(const ShellOptions& options);
EExit RunMergeReport(const ShellOptions& options);
EExit RunInfo(const ShellOptions& options);
EExit RunPose(const ShellOptions& options);
EExit RunTranscode(const ShellOptions& options);
EExit RunResave(const ShellOptions& options);
EExit RunExtract(const ShellOptions& options);
EExit RunPackage(const ShellOptions& options);
EExit RunProfiles(const ShellOptions& options);
EExit RunSuggest(const ShellOptions& options);
EExit RunCompare(const ShellOptions& options);
EExit RunDump(const ShellOptions& options);
EExit RunRender(const ShellOptions& options);
EExit RunDoctor(const ShellOptions& options);
EExit RunAlign(const ShellOptions& options);

} // namespace gw
