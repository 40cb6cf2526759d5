#include "ProfileRows.h"

#include "ApplyRow.h"
#include "CRetargeter.h"
#include "FindBone.h"
#include "HostBones.h"
#include "ProfileFile.h"
#include "SharedPrefix.h"
#include "Text.h"

#include <vector>

namespace gw {

namespace {

// Whether the last row finds its source.
bool FindsSource(const CMapRowTable& rows, const CBoneNames& sources)
{
    const int last = rows.RowCount() - 1;
    return last < 0 || rows.IsFixed(last) || sources.Find(rows.Text(last, kSourceColumn)) != nullptr;
}

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
    profile = RowsOfText(text);
    return true;
}

ProfileRows RowsOfText(std::string_view text)
{
    CProfileReader reader(text);
    ProfileRows profile;
    profile.name = reader.Name();
    for (CProfileLine line; reader.Next(line);)
        TakeLine(line, profile);
    profile.rows.AddPelvisRows();
    return profile;
}

bool NamesSourcesOf(std::string_view text, const CBoneNames& sources)
{
    CProfileReader reader(text);
    ProfileRows profile;
    for (CProfileLine line; reader.Next(line);)
    {
        TakeLine(line, profile);
        if (!FindsSource(profile.rows, sources))
            return false;
    }
    return true;
}

std::string TextOf(const ProfileRows& profile)
{
    return ProfileText(profile.name, profile.frameRate, profile.position, profile.rows);
}

std::string SourcePrefix(const CMapRowTable& rows)
{
    std::vector<std::string_view> names;
    for (int row = 0; row < rows.RowCount(); ++row)
    {
        if (!rows.IsFixed(row))
            names.push_back(rows.Text(row, kSourceColumn));
    }
    return names.size() > 1 ? CommonStart(names) : std::string();
}

CMapRowTable WithPrefix(const CMapRowTable& rows, std::string_view oldPrefix, std::string_view newPrefix)
{
    CMapRowTable changed;
    for (int row = 0; row < rows.RowCount(); ++row)
    {
        std::string source = rows.Text(row, kSourceColumn);
        if (!rows.IsFixed(row))
            source.replace(0, oldPrefix.size(), newPrefix);
        changed.AddRow(source, rows.Text(row, kTargetColumn), rows.Numbers(row), ERowColumns::All);
    }
    return changed;
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
        match.mappedCount += fit == ERowFit::Mapped ? 1 : 0;
        if (EqualNoCase(rows.Text(row, kTargetColumn), kRootBone))
            match.drivesRoot = fit == ERowFit::Mapped;
    }
    return match;
}

} // namespace gw
