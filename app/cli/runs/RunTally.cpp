#include "RunTally.h"

#include "CJsonWriter.h"
#include "Words.h"

#include <cstdio>

namespace gw {

void TellTally(const ShellOptions& options, const RunTally& tally)
{
    const size_t converted = tally[EConversion::Converted] + tally[EConversion::Planned];
    const size_t skipped = tally[EConversion::Skipped];
    const size_t failed = tally[EConversion::Failed];
    if (!options.json)
    {
        SayWord(options, std::to_string(converted) + (options.dryRun ? " to convert, " : " converted, ") +
                             std::to_string(skipped) + " skipped, " + std::to_string(failed) + " failed, " +
                             std::to_string(tally.left) + " left");
        return;
    }
    CJsonWriter json(stdout);
    json.BeginObject();
    json.Key("converted").Integer(static_cast<int64_t>(converted));
    json.Key("skipped").Integer(static_cast<int64_t>(skipped));
    json.Key("failed").Integer(static_cast<int64_t>(failed));
    json.Key("left").Integer(static_cast<int64_t>(tally.left));
    json.EndObject();
    json.EndDocument();
}

} // namespace gw
