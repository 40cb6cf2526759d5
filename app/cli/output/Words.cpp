#include "Words.h"

#include "CFailureRecord.h"
#include "FindingWords.h"
#include "Notice.h"
#include "ShellOptions.h"
#include "SystemError.h"
#include "Text.h"

#include <cstdio>

namespace gw {

void SayError(std::string_view words)
{
    // One write per line, so that lines of several programs on one terminal do not interleave.
    const std::string line = "gaitwright: " + std::string(words) + '\n';
    std::fwrite(line.data(), 1, line.size(), stderr);
}

bool Refuse(std::string_view words)
{
    SayError(words);
    return false;
}

void SayWord(const ShellOptions& options, std::string_view words)
{
    if (!options.quiet)
        SayError(words);
}

void SayNotice(const ShellOptions& options, const Notice& notice)
{
    if (notice.IsWarning())
        SayWord(options, "warning: " + NoticeLine(notice));
    else
        SayError(NoticeLine(notice));
}

void SayFailure(const std::string& path, const Finding& failure)
{
    SayError(NoticeLine(MakeNotice(path, failure)));
}

void SayNotWritten(const std::string& path)
{
    SayFailure(path, {.reason = EFailure::WriteError, .systemError = TakeSystemError()});
}

void SayWarnings(const ShellOptions& options, const std::string& path, const CFailureRecord& record)
{
    for (const Finding& warning : record.Warnings())
        SayNotice(options, MakeNotice(path, warning));
}

void SayDamage(const std::string& path, const Finding& failure)
{
    const std::string place = failure.where == 0 ? "" : " at byte " + std::to_string(failure.where);
    SayError(Printable(path) + ": damaged" + place + ": " + MakeNotice(path, failure).words);
}

} // namespace gw
