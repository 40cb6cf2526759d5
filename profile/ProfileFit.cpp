#include "ProfileFit.h"

#include "CMapRowTable.h"
#include "FindBone.h"
#include "HostBones.h"
#include "Text.h"

namespace gw {

namespace {

// A profile with more missing bones belongs to another skeleton, and comparing names takes time.
constexpr size_t kNearestLimit = 100;

bool Has(const CBoneNames& bones, const std::string& name, ESkeletonSide side, int row, CProfileFit& fit)
{
    if (bones.Find(name))
        return true;
    const bool compare = fit.missing.size() < kNearestLimit;
    fit.missing.push_back({side, name, compare ? NearestName(name, bones.Names()) : std::string(), row, 0});
    return false;
}

// Returns the rows as loading the file would leave them, and the line of each.
CMapRowTable ReadRows(CProfileReader& reader, std::vector<size_t>& lines)
{
    CMapRowTable rows;
    ProfileLine line;
    while (reader.Next(line))
    {
        if (line.kind == EProfileLine::Fixed || line.kind == EProfileLine::Mapping)
            rows.AddRow(line.source, line.target, line.Numbers(), ERowColumns::All);
        lines.resize(static_cast<size_t>(rows.RowCount()), line.line);
    }
    rows.AddPelvisRows();
    lines.resize(static_cast<size_t>(rows.RowCount()));
    return rows;
}

} // namespace

CProfileFit MeasureFit(const CMapRowTable& rows, CNode* sourceRoot, CNode* targetRoot)
{
    const CBoneNames sources(sourceRoot);
    const CBoneNames targets(targetRoot);
    CProfileFit fit;
    fit.rowCount = rows.RowCount();
    for (int row = 0; row < rows.RowCount(); ++row)
    {
        const std::string& target = rows.Text(row, kTargetColumn);
        const bool fixed = rows.IsFixed(row);
        const bool hasSource =
            fixed || Has(sources, rows.Text(row, kSourceColumn), ESkeletonSide::Source, row, fit);
        const bool hasTarget = Has(targets, target, ESkeletonSide::Target, row, fit);
        fit.foundCount += hasSource && hasTarget ? 1 : 0;
        if (EqualNoCase(target, kRootBone))
            fit.drivesRoot = !fixed && hasSource && hasTarget;
    }
    return fit;
}

bool MeasureFit(const std::string& path, CNode* sourceRoot, CNode* targetRoot, CProfileFit& fit)
{
    std::string text;
    if (!ReadProfileText(path, text))
        return false;
    CProfileReader reader(text);
    std::vector<size_t> lines;
    fit = MeasureFit(ReadRows(reader, lines), sourceRoot, targetRoot);
    fit.name = reader.Name();
    for (MissingBone& bone : fit.missing)
        bone.line = lines[static_cast<size_t>(bone.row)];
    return true;
}

} // namespace gw
