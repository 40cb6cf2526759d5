// The part of the JSON output that is the same for all commands. Commands often fail in a function that
// prints the reason and returns false, so the first printed error is kept (FirstError) and becomes the error
// of an object that is written at the end.

#include "JsonStatus.h"

#include "CJsonWriter.h"
#include "Notice.h"
#include "ShellOptions.h"
#include "Words.h"

#include <algorithm>

namespace gw {

namespace {

/// What this process has written so far.
struct WrittenStatus
{
    bool any = false;
    bool failed = false;
};

WrittenStatus& Written()
{
    static WrittenStatus written;
    return written;
}

void WritePlace(CJsonWriter& json, const char* key, bool isKnown, size_t where)
{
    json.Key(key);
    if (isKnown && where != 0)
        json.Integer(static_cast<int64_t>(where));
    else
        json.Null();
}

// The error of a command that has not written one itself.
Notice ErrorOf(EExit exit)
{
    Notice error = FirstError();
    if (error.code.empty())
        error.code = exit == EExit::Usage ? "usage" : "failed";
    if (error.words.empty())
        error.words = "the command failed";
    return error;
}

} // namespace

void WriteStatus(CJsonWriter& json, std::string_view status)
{
    json.Key("status").Text(status);
    Written().any = true;
}

void WriteFailed(CJsonWriter& json, const Notice& error)
{
    WriteStatus(json, "failed");
    Written().failed = true;
    const bool isByte = IsBinary(error.path);
    json.Key("error").BeginObject();
    json.Key("reason").Text(error.code.empty() ? "failed" : error.code);
    json.Key("path").Text(error.path);
    WritePlace(json, "line", !isByte, error.where);
    WritePlace(json, "byte", isByte, error.where);
    json.Key("name").Text(error.name);
    json.Key("words").Text(error.words);
    json.EndObject();
}

void WriteStatus(CJsonWriter& json, std::string_view status, const std::vector<Notice>& notices)
{
    const auto error = std::ranges::find_if_not(notices, &Notice::IsWarning);
    if (error == notices.end())
        WriteStatus(json, status);
    else
        WriteFailed(json, *error);
}

bool IsJsonAsked(int argc, char** argv)
{
    for (int i = 1; i < argc && argv[i] != std::string_view("--"); ++i)
    {
        if (argv[i] == std::string_view("--json"))
            return true;
    }
    return false;
}

void FinishJson(std::string_view command, EExit exit)
{
    const bool isGood = exit == EExit::Done;
    if (isGood ? Written().any : Written().failed)
        return;
    CJsonWriter json(stdout);
    json.BeginObject();
    json.Key("command").Text(command);
    if (isGood)
        WriteStatus(json, "ok");
    else
        WriteFailed(json, ErrorOf(exit));
    json.EndObject();
    json.EndDocument();
}

} // namespace gw
