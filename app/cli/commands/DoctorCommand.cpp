// `doctor`: examines motion files and optionally writes a repaired copy. The exit code of --fix depends on
// the copy, because that is the file that will be used next.

#include "CFileExam.h"
#include "CJsonWriter.h"
#include "COutputFile.h"
#include "Color.h"
#include "CommandTable.h"
#include "ExamineFile.h"
#include "FindingWords.h"
#include "JsonStatus.h"
#include "Notice.h"
#include "OpenSource.h"
#include "Output.h"
#include "Paths.h"
#include "Streams.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>
#include <cstdio>

namespace gw {

namespace {

// Returns false, after printing the reason, if there is nothing to examine.
bool Examine(const std::string& path, CFileExam& exam)
{
    CSourceFile source;
    if (!OpenSource(source, path, EPackage::Kept))
        return false;
    ExamineFile(source.Path(), exam);
    return true;
}

void PrintLine(const std::string& line)
{
    std::printf("%s\n", line.c_str());
}

// The code has a color that shows the severity.
std::string ColoredLine(const std::string& path, const Finding& finding)
{
    std::string line = FindingLine(path, finding);
    const std::string_view code = FindingCode(finding);
    const size_t place = line.find(std::string(code) + ": ", Printable(path).size());
    const EColor color = finding.severity == ESeverity::Error ? EColor::Red : EColor::Yellow;
    return place == line.npos ? line : line.replace(place, code.size(), Colored(stdout, color, code));
}

// Notes are listed with the facts.
void PrintFaults(const std::string& path, const CFindings& findings)
{
    for (const Finding& finding : findings.Sorted())
    {
        if (finding.severity != ESeverity::Note)
            PrintLine(ColoredLine(path, finding));
    }
}

void Print(const ShellOptions& options, const std::string& path, const CFileExam& exam)
{
    PrintFaults(path, exam.Findings());
    if (options.quiet)
        return;
    if (!exam.Facts() && !exam.Findings().HasFaults())
        PrintLine(Printable(path) + ": intact; a container has no poses to check");
    if (!exam.Facts())
        return;
    const bool mixed = exam.Findings().Has(EFailure::MixedChannels);
    PrintLine(Printable(path) + ": " + FactsLine(*exam.Facts()) + (mixed ? ", rotation orders: mixed" : ""));
}

// `fixed`: a repaired copy was written.
void WriteFinding(CJsonWriter& json, const std::string& path, const Finding& finding, bool fixed)
{
    json.BeginObject();
    json.Key("line").Integer(static_cast<int64_t>(finding.where));
    json.Key("code").Text(FindingCode(finding));
    json.Key("severity").Text(SeverityName(finding.severity));
    json.Key("name").Text(finding.name);
    json.Key("words").Text(FindingWords(path, finding));
    json.Key("remedy").Text(FindingRemedy(finding));
    json.Key("more").Integer(static_cast<int64_t>(finding.more));
    json.Key("fixable").Bool(finding.mendable);
    json.Key("fixed").Bool(finding.mendable && fixed);
    json.EndObject();
}

void WriteFindings(CJsonWriter& json, const std::string& path, const CFindings& findings, bool fixed)
{
    json.BeginArray();
    for (const Finding& finding : findings.Sorted())
        WriteFinding(json, path, finding, fixed);
    json.EndArray();
}

void WriteFacts(CJsonWriter& json, const std::optional<MotionFacts>& facts)
{
    if (!facts)
        return json.Null();
    json.BeginObject();
    json.Key("joints").Integer(static_cast<int64_t>(facts->jointCount));
    json.Key("frames").Integer(static_cast<int64_t>(facts->frameCount));
    json.Key("frameSeconds").Number(static_cast<float>(facts->frameSeconds));
    json.Key("leg").Number(static_cast<float>(facts->leg));
    json.Key("unit").Text(facts->unit);
    json.Key("up").Text(facts->up);
    json.Key("restPose").Text(RestPoseName(facts->restPose));
    json.Key("body").Text(BodySourceName(facts->body));
    json.EndObject();
}

void WriteHealth(CJsonWriter& json, const std::string& path, const CFindings& findings)
{
    const std::vector<Finding> sorted = findings.Sorted();
    const auto fault = std::ranges::find(sorted, ESeverity::Error, &Finding::severity);
    if (!findings.HasFaults())
        WriteStatus(json, "ok");
    else if (fault == sorted.end())
        WriteFailed(json, MakeNotice(path, sorted.front()));
    else
        WriteFailed(json, MakeNotice(path, *fault));
}

// Writes a file's object without its end, so that a repaired copy can be added.
void BeginJson(CJsonWriter& json, const std::string& path, const CFileExam& exam, bool fixed)
{
    json.BeginObject();
    WriteHealth(json, path, exam.Findings());
    json.Key("file").Text(path);
    json.Key("healthy").Bool(!exam.Findings().HasFaults());
    json.Key("facts");
    WriteFacts(json, exam.Facts());
    json.Key("findings");
    WriteFindings(json, path, exam.Findings(), fixed);
}

void Tell(const ShellOptions& options, const std::string& path, const CFileExam& exam)
{
    if (!options.json)
        return Print(options, path, exam);
    CJsonWriter json(stdout);
    BeginJson(json, path, exam, false);
    json.EndObject();
    json.EndDocument();
}

EExit ExamineFile(const ShellOptions& options, const std::string& path)
{
    CFileExam exam;
    if (!Examine(path, exam))
        return EExit::Failed;
    Tell(options, path, exam);
    return exam.Findings().HasFaults() ? EExit::Failed : EExit::Done;
}

void WriteSummary(size_t files, size_t faulty)
{
    CJsonWriter json(stdout);
    json.BeginObject();
    json.Key("summary").Bool(true);
    if (faulty == 0)
        WriteStatus(json, "ok");
    else
        WriteFailed(json, MakeNotice({}, "faults", std::to_string(faulty) + " files have faults"));
    json.Key("files").Integer(static_cast<int64_t>(files));
    json.Key("faulty").Integer(static_cast<int64_t>(faulty));
    json.EndObject();
    json.EndDocument();
}

bool CanFix(const ShellOptions& options)
{
    if (options.files.size() != 1)
        return Refuse("--fix needs exactly one file");
    const std::string& source = options.files[0];
    const auto isBVH = [](const std::string& path) { return HasExtension(path, ".bvh") || IsStream(path); };
    if (!isBVH(source) || !isBVH(options.fix))
        return Refuse("--fix writes a repaired .bvh from a .bvh");
    if (IsSameFile(source, options.fix))
        return Refuse(Printable(source) + ": a file is never repaired in place; pass another name to --fix");
    return true;
}

void WriteFixedJson(const ShellOptions& options, const CFileExam& exam, const CFileExam& copy)
{
    CJsonWriter json(stdout);
    BeginJson(json, options.files[0], exam, true);
    json.Key("output").Text(options.fix);
    json.Key("left");
    WriteFindings(json, options.fix, copy.Findings(), false);
    json.EndObject();
    json.EndDocument();
}

void TellFixed(const ShellOptions& options, const CFileExam& exam, const CFileExam& copy)
{
    if (options.json)
        return WriteFixedJson(options, exam, copy);
    const std::string& source = options.files[0];
    Print(options, source, exam);
    std::string line = Printable(source) + " -> " + Printable(options.fix) + ": ";
    line += exam.Findings().HasFaults() ? "repaired" : "nothing to repair";
    if (copy.Findings().HasFaults())
        line += ", but these faults are left";
    PrintLine(line);
    PrintFaults(options.fix, copy.Findings());
}

// Only the state of the copy counts, because that is what will be used next.
EExit FixFile(const ShellOptions& options)
{
    const std::string& source = options.files[0];
    CFileExam exam;
    COutputFile output;
    if (!output.Open(options, options.fix, ".bvh") || !Examine(source, exam))
        return EExit::Failed;
    if (exam.Findings().HasFaults() && !exam.Findings().MendsAny())
    {
        Tell(options, source, exam);
        SayError(source, "not-fixable", "none of these faults can be repaired, so no copy was written");
        return EExit::Failed;
    }
    if (!exam.WriteMended(output.Path()))
    {
        SayNotWritten(options.fix);
        return EExit::Failed;
    }
    CFileExam copy;
    Examine(output.Path(), copy);
    if (!output.DeliverOrSay())
        return EExit::Failed;
    if (IsStandardOutput(options.fix))
        return copy.Findings().HasFaults() ? EExit::Failed : EExit::Done;
    TellFixed(options, exam, copy);
    return copy.Findings().HasFaults() ? EExit::Failed : EExit::Done;
}

} // namespace

EExit RunDoctor(const ShellOptions& options)
{
    if (!options.fix.empty())
    {
        if (!CanFix(options))
            return EExit::Usage;
        return FixFile(options);
    }
    size_t faulty = 0;
    for (const std::string& path : options.files)
        faulty += ExamineFile(options, path) == EExit::Done ? 0 : 1;
    if (options.json && options.files.size() > 1)
        WriteSummary(options.files.size(), faulty);
    return faulty == 0 ? EExit::Done : EExit::Failed;
}

} // namespace gw
