#pragma once

#include "ShellOptions.h"

#include <cstddef>
#include <span>
#include <string_view>

namespace gw {

/// The options that a command can take, one bit each.
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
};

/// The options that say how a run goes, and nothing about what a source is converted to. Any other is part of
/// a plan, and of what --resume compares: one too many there costs time, one too few would leave old results.
inline constexpr uint64_t kHowToRun = kOutput | kOutputFolder | kForce | kSkipExisting | kDryRun |
                                      kKeepGoing | kDataFolder | kJson | kQuiet | kJobs | kFilesFrom | kNull |
                                      kResume | kReport | kTimeLimit | kShards | kShard;

/// One command of the program.
struct ShellCommand
{
    std::string_view name;
    std::string_view operands; ///< as the usage line shows them: "IN OUT", "[SOURCE]", "SOURCE..."
    uint64_t options;          ///< bits of EOption beside those that every command takes
    uint64_t required;         ///< which of them must be there
    EExit (*run)(const ShellOptions& options);
    std::string_view help; ///< the first line stands in the list of commands
    std::string_view example;
    uint64_t choice; ///< of these exactly one must be there; 0 for no such choice
};

/// How many operands a command takes.
size_t LeastOperands(const ShellCommand& command);
size_t MostOperands(const ShellCommand& command);

/// The table of commands, in the order of the help.
std::span<const ShellCommand> Commands();

// The commands. Each prints results on standard output and words on standard error.
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
