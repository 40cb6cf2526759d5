// Examinations of motion files, and repaired copies.

#include "CFileExam.h"
#include "CSourceFile.h"
#include "ExamineFile.h"
#include "Failures.h"
#include "FindingWords.h"
#include "Paths.h"
#include "Writing.h"

namespace gaitwright {

namespace {

Finding FindingOf(const std::string& path, const gw::Finding& finding)
{
    return {.severity = static_cast<Severity>(finding.severity),
            .reason = std::string(gw::FindingCode(finding)),
            .line = finding.where,
            .name = finding.name,
            .words = gw::FindingWords(path, finding),
            .remedy = std::string(gw::FindingRemedy(finding)),
            .more = finding.more,
            .fixable = finding.mendable};
}

MotionFacts FactsOf(const gw::MotionFacts& facts)
{
    return {.jointCount = facts.jointCount,
            .frameCount = facts.frameCount,
            .frameSeconds = facts.frameSeconds,
            .leg = facts.leg,
            .unit = std::string(facts.unit),
            .up = std::string(facts.up),
            .restPose = std::string(gw::RestPoseName(facts.restPose)),
            .body = std::string(gw::BodySourceName(facts.body))};
}

Examination ExaminationOf(const std::string& path, const gw::CFileExam& exam)
{
    Examination examination{.healthy = !exam.Findings().HasFaults(), .findings = {}, .facts = {}};
    for (const gw::Finding& finding : exam.Findings().Sorted())
        examination.findings.push_back(FindingOf(path, finding));
    if (exam.Facts())
        examination.facts = FactsOf(*exam.Facts());
    return examination;
}

Outcome<Examination> MendFile(const std::string& path, const std::string& output, Existing existing)
{
    if (!gw::HasExtension(path, ".bvh") || !gw::HasExtension(output, ".bvh"))
        return FailureOf("unknown-format", "a repaired .bvh is written from a .bvh");
    if (gw::IsSameFile(path, output))
        return FailureOf("own-source", "a file is never repaired in place");
    gw::CFileExam exam;
    gw::ExamineFile(path, exam);
    if (exam.Findings().HasFaults() && !exam.Findings().MendsAny())
        return FailureOf("not-fixable", "none of the faults can be repaired");
    const Outcome<void> written = WriteFile(output, existing, [&](const std::string& to) {
        return WriteText(to, [&](const gw::CTextSink& send) { return exam.WriteMended(send); });
    });
    if (!written)
        return written.Error();
    return Doctor(output);
}

} // namespace

Outcome<Examination> Doctor(const std::string& path) noexcept
{
    return Guarded([&]() -> Outcome<Examination> {
        gw::CSourceFile source;
        if (!source.Open(path))
            return FailureOf(source.Failure());
        gw::CFileExam exam;
        gw::ExamineFile(source.Path(), exam);
        return ExaminationOf(path, exam);
    });
}

Outcome<Examination> Mend(const std::string& path, const std::string& output, Existing existing) noexcept
{
    return Guarded([&] { return MendFile(path, output, existing); });
}

} // namespace gaitwright
