#include "ProfileRows.h"

#include "ApplyRow.h"
#include "CRetargeter.h"
#include "FindBone.h"
#include "HostBones.h"
#include "ProfileFile.h"
#include "Text.h"

namespace gw {

namespace {

void TakeLine(const CProfileLine& line, ProfileRows& profile)
{
    switch (line.kind)
    {
    case EProfileLine::Position:
        profile.position = line.position;
        break;
    case EProfileLine::FrameRate:
        profile.frameRate = line.frameRate;
        break;
    case EProfileLine::Fixed:
    case EProfileLine::Mapping:
        profile.rows.AddRow(line.source, line.target, line.numbers, ERowColumns::All);
        break;
    }
}

} // namespace

bool ReadProfileRows(const std::string& path, ProfileRows& profile)
{
    std::string text;
    if (!ReadProfileText(path, text))
        return false;
    CProfileReader reader(text);
    profile = {};
    profile.name = reader.Name();
    for (CProfileLine line; reader.Next(line);)
        TakeLine(line, profile);
    profile.rows.AddPelvisRows();
    return true;
}

std::string TextOf(const ProfileRows& profile)
{
    return ProfileText(profile.name, profile.frameRate, profile.position, profile.rows);
}

RowMatch ApplyRows(const CMapRowTable& rows, const CBoneNames& sources, const CBoneNames& targets,
                   CRetargeter& table)
{
    RowMatch match;
    for (int row = 0; row < rows.RowCount(); ++row)
    {
        const ERowFit fit = ApplyRow(rows, row, sources, targets, &table);
        ++match.rowCount;
        match.foundCount += fit == ERowFit::Missing ? 0 : 1;
        if (EqualNoCase(rows.Text(row, kTargetColumn), kRootBone))
            match.drivesRoot = fit == ERowFit::Mapped;
    }
    return match;
}

} // namespace gw
