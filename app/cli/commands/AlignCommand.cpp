// `align`: writes a motion relative to a T-pose, and prints what was corrected.

#include "CJsonWriter.h"
#include "CShellConversion.h"
#include "CShellNotices.h"
#include "CommandTable.h"
#include "CorrectionWords.h"
#include "Corrections.h"
#include "NoticeJson.h"
#include "Output.h"
#include "Paths.h"
#include "Text.h"
#include "Words.h"

#include <cstdio>

namespace gw {

namespace {

void WriteJson(const ShellOptions& options, const CShellNotices& notices, const Corrections& corrections,
               bool written)
{
    CJsonWriter json(stdout);
    json.BeginObject();
    json.Key("source").Text(options.files[0]);
    json.Key("output").Text(options.output);
    json.Key("outcome").Text(written ? "aligned" : "failed");
    json.Key("referenceFrame").Integer(corrections.referenceFrame);
    json.Key("mended").BeginArray();
    for (const Correction& correction : corrections.list)
    {
        json.BeginObject();
        json.Key("need").Text(CorrectionCode(correction.kind));
        json.Key("joint").Text(correction.joint);
        json.Key("degrees").Number(static_cast<float>(correction.degrees));
        json.EndObject();
    }
    json.EndArray();
    WriteNotices(json, notices.All());
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
    CShellNotices notices(options);
    CShellConversion conversion(options, {true, false}, notices);
    const bool written = conversion.Open(options.files[0]) && conversion.SelectProfile() &&
                         conversion.WriteAligned(options.output);
    if (options.json)
        WriteJson(options, notices, conversion.Corrected(), written);
    else if (written && !options.quiet)
        std::printf("%s -> %s: %s\n", Printable(options.files[0]).c_str(), Printable(options.output).c_str(),
                    CorrectionWords(conversion.Corrected()).c_str());
    return written ? EExit::Done : EExit::Failed;
}

} // namespace gw
