// `align`: writes a motion relative to a T-pose, and prints what was corrected.

#include "AlignReport.h"
#include "CJsonWriter.h"
#include "CShellConversion.h"
#include "CShellReports.h"
#include "CommandTable.h"
#include "Output.h"
#include "Paths.h"
#include "ReportJson.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>
#include <cstdio>

namespace gw {

namespace {

struct NeedWords
{
    EAlignNeed need;
    const char* code;
    const char* one; ///< "1 joint ..."
    const char* many;
};

constexpr NeedWords kNeeds[] = {
    {EAlignNeed::RestPose,         "rest-pose",      "bone off its axis at rest",       "bones off their axes at rest"},
    {EAlignNeed::UpAxis,           "up-axis",        "up axis that is not Y",           "up axes that are not Y"      },
    {EAlignNeed::BoneFrames,       "bone-frame",     "rotated frame of a slanted bone",
     "rotated frames of slanted bones"                                                                                },
    {EAlignNeed::DoubledPositions, "doubled-offset", "doubled bone",                    "doubled bones"               },
};

const char* CodeOf(EAlignNeed need)
{
    return std::ranges::find(kNeeds, need, &NeedWords::need)->code;
}

// "4 bones off their axes at rest, 2 rotated frames of slanted bones"
std::string MendedText(const AlignReport& report)
{
    std::string text;
    for (const NeedWords& words : kNeeds)
    {
        const auto count = std::ranges::count(report.findings, words.need, &AlignFinding::need);
        if (count == 0)
            continue;
        text +=
            (text.empty() ? "" : ", ") + std::to_string(count) + ' ' + (count == 1 ? words.one : words.many);
    }
    return text.empty() ? "nothing to align" : text;
}

void WriteJson(const ShellOptions& options, const CShellReports& reports, const AlignReport& report,
               bool written)
{
    CJsonWriter json(stdout);
    json.BeginObject();
    json.Key("source").Text(options.files[0]);
    json.Key("output").Text(options.output);
    json.Key("outcome").Text(written ? "aligned" : "failed");
    json.Key("referenceFrame").Integer(report.referenceFrame);
    json.Key("mended").BeginArray();
    for (const AlignFinding& finding : report.findings)
    {
        json.BeginObject();
        json.Key("need").Text(CodeOf(finding.need));
        json.Key("joint").Text(finding.joint);
        json.Key("degrees").Number(static_cast<float>(finding.degrees));
        json.EndObject();
    }
    json.EndArray();
    WriteReports(json, reports.All());
    json.EndObject();
    json.EndDocument();
}

} // namespace

EExit RunAlign(const ShellOptions& options)
{
    if (!HasExtension(options.output, ".bvh"))
    {
        SayError(Printable(options.output) + ": the output must be a .bvh file");
        return EExit::Usage;
    }
    if (!MayWrite(options, options.output))
        return EExit::Failed;
    CShellReports reports(options);
    CShellConversion conversion(options, {true, false}, reports);
    const bool written = conversion.Open(options.files[0]) && conversion.SelectProfile() &&
                         conversion.WriteAligned(options.output);
    if (options.json)
        WriteJson(options, reports, conversion.AlignedReport(), written);
    else if (written && !options.quiet)
        std::printf("%s -> %s: %s\n", Printable(options.files[0]).c_str(), Printable(options.output).c_str(),
                    MendedText(conversion.AlignedReport()).c_str());
    return written ? EExit::Done : EExit::Failed;
}

} // namespace gw
