// `align`: writes a motion relative to a T-pose, and prints what was corrected.

#include "CJsonWriter.h"
#include "COutputFile.h"
#include "CShellConversion.h"
#include "CShellNotices.h"
#include "CommandTable.h"
#include "CorrectionWords.h"
#include "Corrections.h"
#include "JsonStatus.h"
#include "NoticeJson.h"
#include "Output.h"
#include "Paths.h"
#include "Streams.h"
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
    WriteStatus(json, "aligned", notices.All());
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
    if (!HasExtension(options.output, ".bvh") && !IsStream(options.output))
    {
        SayError(Printable(options.output) + ": the output must be a .bvh file");
        return EExit::Usage;
    }
    COutputFile output;
    if (IsSameFile(options.files[0], options.output))
    {
        SayError(options.output, "own-source",
                 "this is the source; choose another name for the aligned copy");
        return EExit::Failed;
    }
    if (!output.Open(options, options.output, ".bvh"))
        return EExit::Failed;
    CShellNotices notices(options);
    notices.ShowAs(output.Path(), options.output);
    CShellConversion conversion(options, {true, false}, notices);
    const bool written = conversion.Open(options.files[0]) && conversion.SelectProfile() &&
                         conversion.WriteAligned(output.Path()) && output.DeliverOrSay();
    if (options.json)
        WriteJson(options, notices, conversion.Corrected(), written);
    else if (written)
        PrintResult(options, options.output,
                    Printable(options.files[0]) + " -> " + Printable(options.output) + ": " +
                        CorrectionWords(conversion.Corrected()));
    return written ? EExit::Done : EExit::Failed;
}

} // namespace gw
