#include "RunTally.h"

#include "CJsonWriter.h"

namespace gw {

namespace {

size_t Converted(const RunTally& tally)
{
    return tally[EConversion::Converted] + tally[EConversion::Planned];
}

} // namespace

std::string TallyWords(const ShellOptions& options, const RunTally& tally)
{
    return std::to_string(Converted(tally)) + (options.dryRun ? " to convert, " : " converted, ") +
           std::to_string(tally[EConversion::Skipped]) + " skipped, " +
           std::to_string(tally[EConversion::Failed]) + " failed, " + std::to_string(tally.left) + " left";
}

void WriteTally(CJsonWriter& json, const ShellOptions& options, const RunTally& tally)
{
    json.Key(options.dryRun ? "would_convert" : "converted").Integer(static_cast<int64_t>(Converted(tally)));
    json.Key("skipped").Integer(static_cast<int64_t>(tally[EConversion::Skipped]));
    json.Key("failed").Integer(static_cast<int64_t>(tally[EConversion::Failed]));
    json.Key("left").Integer(static_cast<int64_t>(tally.left));
}

} // namespace gw
