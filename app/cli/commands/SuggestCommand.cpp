// `suggest`: drafts a bone map for a motion without a fitting one, writes it, and prints its rows with the
// confidence in each, so that a user knows what to check.

#include "CJsonWriter.h"
#include "COutputFile.h"
#include "CSafeFile.h"
#include "CShellConversion.h"
#include "CShellNotices.h"
#include "CommandTable.h"
#include "DoubtWords.h"
#include "DraftedProfile.h"
#include "JsonStatus.h"
#include "Notice.h"
#include "Output.h"
#include "Paths.h"
#include "Streams.h"
#include "SuggestProfile.h"
#include "Text.h"
#include "Words.h"

#include <cstdio>

namespace gw {

namespace {

constexpr const char* kEvidenceWords[] = {
    "no evidence",
    "by shape; the name gives no hint",
    "by shape, although the name disagrees",
    "by name; the shape gives no hint",
    "by name and shape",
};
template <class Enum, size_t count>
const char* Text(const char* const (&words)[count], Enum value)
{
    return words[static_cast<size_t>(value)];
}

std::string Reason(const SuggestedRow& row, const SuggestedProfile& profile)
{
    switch (row.kind)
    {
    case ESuggestedRow::Fixed:
        return "fixed, as in every profile";
    case ESuggestedRow::NoSource:
        return "left out: the skeleton has no " + PlaceWords(row.place);
    case ESuggestedRow::NoName:
        return "left out: the name of this joint cannot be used in a profile";
    default:
        break;
    }
    std::string reason =
        std::string(RowSurenessName(row.sureness)) + ": " + Text(kEvidenceWords, row.evidence);
    for (const EDoubt doubt : row.doubts)
        reason += std::string("; ") + DoubtPhrase(doubt);
    if (row.nudged)
        reason += "; rotated slightly around its own axis, so that the bone below can follow";
    if (!profile.sidesAreSure && HasSides(row.place.joint))
        reason += "; no pose shows which side is left";
    return reason;
}

void PrintRows(const SuggestedProfile& profile)
{
    for (const SuggestedRow& row : profile.rows)
    {
        const auto& [x, y, z] = row.numbers.rotation;
        const auto& [a, b, c] = row.numbers.axes;
        char numbers[64] = "";
        if (row.IsMapping())
            std::snprintf(numbers, sizeof numbers, "%d,%d,%d,%d,%d,%d", x, y, z, a, b, c);
        std::printf("%-11s %-24s %-20s %s\n", Printable(row.target).c_str(),
                    row.source ? Printable(row.source->NameView()).c_str() : "-", numbers,
                    Reason(row, profile).c_str());
    }
}

void WriteNumbers(CJsonWriter& json, const char* key, const std::array<int, 3>& numbers)
{
    json.Key(key).BeginArray();
    for (const int number : numbers)
        json.Integer(number);
    json.EndArray();
}

void WriteRow(CJsonWriter& json, const SuggestedRow& row)
{
    json.BeginObject();
    json.Key("target").Text(row.target);
    json.Key("source").Text(row.source ? row.source->NameView() : "");
    json.Key("joint").Text(row.kind == ESuggestedRow::Fixed ? "" : PlaceWords(row.place));
    json.Key("kind").Text(RowKindCode(row.kind));
    if (row.IsMapping())
    {
        WriteNumbers(json, "rotation", row.numbers.rotation);
        WriteNumbers(json, "axes", row.numbers.axes);
        json.Key("sureness").Text(RowSurenessName(row.sureness));
        json.Key("evidence").Text(EvidenceCode(row.evidence));
        json.Key("doubts").BeginArray();
        for (const EDoubt doubt : row.doubts)
            json.Text(DoubtCode(doubt));
        json.EndArray();
        json.Key("restError");
        if (row.restError)
            json.Number(static_cast<float>(*row.restError));
        else
            json.Null();
    }
    json.EndObject();
}

void WriteJson(const ShellOptions& options, const std::string& name, const SuggestedProfile& profile)
{
    CJsonWriter json(stdout);
    json.BeginObject();
    WriteStatus(json, "ok");
    json.Key("source").Text(options.files[0]);
    json.Key("output").Text(options.output);
    json.Key("name").Text(name);
    json.Key("sidesAreSure").Bool(profile.sidesAreSure);
    json.Key("restIsStance").Bool(profile.restIsStance);
    json.Key("rows").BeginArray();
    for (const SuggestedRow& row : profile.rows)
        WriteRow(json, row);
    json.EndArray();
    json.EndObject();
    json.EndDocument();
}

// Prints which of the thirteen required joints were not found.
EExit FailMissing(const std::string& source, const SuggestedProfile& profile)
{
    SayError(source, "no-body", WhyNotSure(profile));
    for (const SuggestedRow& row : profile.rows)
    {
        if (row.kind == ESuggestedRow::NoName)
            SayError(source, "bad-joint-name",
                     "the " + PlaceWords(row.place) + " would be " + Quoted(row.source->NameView()) +
                         ", but the name of that joint cannot be used in a profile; rename it in the file");
    }
    return EExit::Failed;
}

bool WriteProfile(const std::string& path, const std::string& text)
{
    CSafeFile file;
    if (file.Open(path) && file.Write(text) && file.Commit())
        return true;
    SayNotWritten(path);
    return false;
}

// Writes the profile and prints its rows.
EExit Deliver(const ShellOptions& options, const SuggestedProfile& profile, CNode* sourceRoot,
              COutputFile& output)
{
    const std::string name = SuggestedName(StemOf(options.files[0]));
    if (!WriteProfile(output.Path(), DraftText(profile, StemOf(options.files[0]), sourceRoot)))
        return EExit::Failed;
    if (!output.DeliverOrSay())
        return EExit::Failed;
    if (const std::optional<Notice> warning = RateWarning(options.output, sourceRoot))
        SayNotice(options, *warning);
    if (!profile.turnsFromRest)
        SayWord(options,
                std::string("the rest pose ") +
                    (profile.restIsStance ? "has its legs spread" : "is not a standing pose") +
                    "; the rotation of bones around their own axes was measured in a frame of the motion");
    if (options.json)
    {
        WriteJson(options, name, profile);
        return EExit::Done;
    }
    if (!IsStandardOutput(options.output))
        PrintRows(profile);
    return TellWritten(options, options.files[0], options.output);
}

} // namespace

EExit RunSuggest(const ShellOptions& options)
{
    if (!HasExtension(options.output, ".prf") && !IsStream(options.output))
    {
        SayError(Printable(options.output) + ": the name of a profile must end in .prf");
        return EExit::Usage;
    }
    COutputFile output;
    if (!output.Open(options, options.output, ".prf"))
        return EExit::Failed;
    CShellNotices notices(options);
    CShellConversion conversion(options, {}, notices);
    if (!conversion.ReadSource(options.files[0]) || !conversion.LoadTarget() || notices.HasFailed())
        return EExit::Failed;
    const SuggestedProfile profile =
        SuggestProfile(*conversion.SourceRoot(), *conversion.Result().motionRoot);
    if (!profile.missing.empty())
        return FailMissing(options.files[0], profile);
    return Deliver(options, profile, conversion.SourceRoot(), output);
}

} // namespace gw
