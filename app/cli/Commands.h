#pragma once

#include "COptions.h"

#include <cstddef>
#include <span>
#include <string_view>

namespace gw {

/// The options that a command can take, one bit each.
enum EOption : uint32_t
{
    kOutput = 1u << 0,
    kOutputFolder = 1u << 1,
    kProfile = 1u << 2,
    kJob = 1u << 3,
    kFrame = 1u << 4,
    kRate = 1u << 5,
    kFrameScale = 1u << 6,
    kNoLegs = 1u << 7,
    kForce = 1u << 8,
    kSkipExisting = 1u << 9,
    kDryRun = 1u << 10,
    kKeepGoing = 1u << 11,
    kDataFolder = 1u << 12,
    kJson = 1u << 13,
    kQuiet = 1u << 14,
    kWith = 1u << 15,
    kStrip = 1u << 16,
    kSize = 1u << 17,
    kTime = 1u << 18,
    kObjects = 1u << 19,
    kAlign = 1u << 20,
    kFaithful = 1u << 21,
    kCheck = 1u << 22,
    kHtml = 1u << 23,
    kFix = 1u << 24,
};

/// One command of the program.
struct CCommand
{
    std::string_view name;
    std::string_view operands; ///< as the usage line shows them: "IN OUT", "[SOURCE]", "SOURCE..."
    uint32_t options;          ///< bits of EOption beside those that every command takes
    uint32_t required;         ///< which of them must be there
    EExit (*run)(const COptions& options);
    std::string_view help; ///< the first line stands in the list of commands
    std::string_view example;
    uint32_t choice; ///< of these exactly one must be there; 0 for no such choice
};

/// How many operands a command takes.
size_t LeastOperands(const CCommand& command);
size_t MostOperands(const CCommand& command);

/// The table of commands, in the order of the help.
std::span<const CCommand> Commands();

// The commands. Each prints results on standard output and words on standard error.
EExit RunConvert(const COptions& options);
EExit RunBatchFolder(const COptions& options);
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
