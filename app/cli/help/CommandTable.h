#pragma once

#include "COptions.h"

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
struct CCommand
{
    std::string_view name;
    std::string_view operands; ///< as the usage line shows them: "IN OUT", "[SOURCE]", "SOURCE..."
    uint64_t options;          ///< bits of EOption beside those that every command takes
    uint64_t required;         ///< which of them must be there
    EExit (*run)(const COptions& options);
    std::string_view help; ///< the first line stands in the list of commands
    std::string_view example;
    uint64_t choice; ///< of these exactly one must be there; 0 for no such choice
};

/// How many operands a command takes.
size_t LeastOperands(const CCommand& command);
size_t MostOperands(const CCommand& command);

/// The table of commands, in the order of the help.
std::span<const CCommand> Commands();

// The commands. Each prints results on standard output and words on standard error.
EExit RunConvert(const COptions& options);
EExit RunBatchFolder(const COptions& options);
EExit RunPlan(const COptions& options);
EExit RunShard(const COptions& options);
EExit RunMergeReport(const COptions& options);
EExit RunInfo(const COptions& options);
EExit RunPose(const COptions& options);
EExit RunTranscode(const COptions& options);
EExit RunResave(const COptions& options);
EExit RunExtract(const COptions& options);
EExit RunPackage(const COptions& options);
EExit RunProfiles(const COptions& options);
EExit RunSuggest(const COptions& options);
EExit RunCompare(const COptions& options);
EExit RunDump(const COptions& options);
EExit RunRender(const COptions& options);
EExit RunDoctor(const COptions& options);
EExit RunAlign(const COptions& options);

} // namespace gw
