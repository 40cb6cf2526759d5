#include "Words.h"

#include "CFailureRecord.h"
#include "Color.h"
#include "FindingWords.h"
#include "Notice.h"
#include "ShellOptions.h"
#include "SystemError.h"
#include "Text.h"

#include <cstdio>

namespace gw {

namespace {

constexpr std::string_view kProgramPrefix = "gaitwright:";

Notice& KeptError()
{
    static Notice error;
    return error;
}

void Keep(const Notice& error)
{
    if (KeptError().words.empty())
        KeptError() = error;
}

// One write per line, so that lines of several programs on one terminal do not interleave.
void Say(std::string_view prefix, std::string_view words)
{
    const std::string line = std::string(prefix) + ' ' + std::string(words) + '\n';
    std::fwrite(line.data(), 1, line.size(), stderr);
}

void SayRed(std::string_view words)
{
    Say(Colored(stderr, EColor::Red, kProgramPrefix), words);
}

void SayKept(const Notice& error)
{
    Keep(error);
    SayRed(NoticeLine(error));
}

} // namespace

void SayError(std::string_view words)
{
    Keep(MakeNotice({}, "", std::string(words)));
    SayRed(words);
}

void SayError(const std::string& path, const char* code, const std::string& words)
{
    SayKept(MakeNotice(path, code, words));
}

const Notice& FirstError()
{
    return KeptError();
}

void SayPlain(std::string_view words)
{
    Say(kProgramPrefix, words);
}

void SayWarning(const ShellOptions& options, std::string_view words)
{
    if (!options.quiet)
        Say(Colored(stderr, EColor::Yellow, std::string(kProgramPrefix) + " warning:"), words);
}

bool Refuse(std::string_view words)
{
    SayError(words);
    return false;
}

bool Refuse(const char* code, const std::string& words)
{
    SayError({}, code, words);
    return false;
}

void SayWord(const ShellOptions& options, std::string_view words)
{
    if (!options.quiet)
        SayPlain(words);
}

void SayNotice(const ShellOptions& options, const Notice& notice)
{
    if (notice.IsWarning())
        SayWarning(options, NoticeLine(notice));
    else
        SayKept(notice);
}

void SayFailure(const std::string& path, const Finding& failure)
{
    SayKept(MakeNotice(path, failure));
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
    const Notice notice = MakeNotice(path, failure);
    Keep(notice);
    SayRed(Printable(path) + ": damaged" + place + ": " + notice.words);
}

} // namespace gw
