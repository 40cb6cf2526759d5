#include "ProfileFit.h"

#include "FindBone.h"
#include "HostBones.h"
#include "ProfileFile.h"
#include "Text.h"

#include <unordered_set>

namespace gw {

namespace {

// Looks up rows and keeps what is missing.
class CFitMeter
{
public:
    CFitMeter(CNode* sourceRoot, CNode* targetRoot, CProfileFit& fit)
        : m_kSources(sourceRoot), m_kTargets(targetRoot), m_kFit(fit)
    {
    }

    // A later row of the same target changes numbers, and never the bones.
    void AddRow(const CProfileLine& row)
    {
        if (!m_kSeen.insert(LowerCase(row.target)).second)
            return;
        const bool hasSource =
            row.kind == EProfileLine::Fixed || Has(m_kSources, ESkeletonSide::Source, row.source, row.line);
        const bool hasTarget = Has(m_kTargets, ESkeletonSide::Target, row.target, row.line);
        ++m_kFit.rowCount;
        m_kFit.foundCount += hasSource && hasTarget ? 1 : 0;
        if (row.kind == EProfileLine::Mapping && EqualNoCase(row.target, kRootBone))
            m_kFit.drivesRoot = hasSource && hasTarget;
    }

private:
    bool Has(const CBoneNames& bones, ESkeletonSide side, const std::string& name, size_t line)
    {
        if (bones.Find(name))
            return true;
        m_kFit.missing.push_back({side, name, NearestName(name, bones.Names()), line});
        return false;
    }

    CBoneNames m_kSources;
    CBoneNames m_kTargets;
    CProfileFit& m_kFit;
    std::unordered_set<std::string> m_kSeen; // targets in lower case
};

} // namespace

bool MeasureFit(const std::string& path, CNode* sourceRoot, CNode* targetRoot, CProfileFit& fit)
{
    std::string text;
    if (!ReadProfileText(path, text))
        return false;
    fit = {};
    CProfileReader reader(text);
    fit.name = reader.Name();
    CFitMeter meter(sourceRoot, targetRoot, fit);
    CProfileLine line;
    while (reader.Next(line))
    {
        if (line.kind == EProfileLine::Fixed || line.kind == EProfileLine::Mapping)
            meter.AddRow(line);
    }
    for (const std::string_view pelvis : kPelvisBones)
    {
        CProfileLine row;
        row.kind = EProfileLine::Fixed;
        row.target = pelvis;
        meter.AddRow(row);
    }
    return true;
}

} // namespace gw
