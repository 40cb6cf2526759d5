#include "RunRecord.h"

#include "CJsonWriter.h"
#include "CTextFile.h"

#include <algorithm>
#include <charconv>

namespace gw {

std::string RecordHead(const ConversionJob& job)
{
    CTextFile text;
    {
        CJsonWriter json(text.File());
        json.BeginObject();
        json.Key("source").Text(job.source);
        json.Key("output").Text(job.output);
    }
    return text.Text() + ',';
}

std::string Timed(std::string record, double seconds)
{
    record.resize(std::min(record.size(), record.rfind('}')));
    char digits[64];
    char* const end = std::to_chars(digits, std::end(digits), seconds, std::chars_format::fixed, 4).ptr;
    return record + ",\"seconds\":" + std::string(&digits[0], end);
}

Notice LostNotice(const ConversionJob& job, const JobEnd& end, float limit)
{
    if (end.kind == JobEnd::EKind::TimedOut)
        return MakeNotice(job.source, "time-limit",
                          "not done within " + std::to_string(static_cast<int64_t>(limit)) +
                              " seconds, so it was stopped; use --time-limit to allow more");
    if (end.kind == JobEnd::EKind::Ran)
        return MakeNotice(job.source, "no-record",
                          "the messages about it cannot be stored (is there a limit on the size of "
                          "files?)");
    return MakeNotice(job.source, "crashed",
                      "the conversion crashed (" + end.cause + "); nothing was written");
}

} // namespace gw
