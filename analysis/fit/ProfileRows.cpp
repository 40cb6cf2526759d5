// Profiles as rows in memory, as loading them in the editor would leave them, and variants with another name
// prefix. RowsThatMayFit stops at the first missing bone, which makes choosing among many profiles cheap.

#include "ProfileRows.h"

#include "FindBone.h"
#include "HostBones.h"
#include "ProfileFile.h"
#include "SharedPrefix.h"
#include "Text.h"

#include <algorithm>
#include <functional>
#include <vector>

namespace gw {

namespace {

void TakeLine(const ProfileLine& line, ProfileRows& profile)
{
    switch (line.kind)
    {
    case EProfileLine::Position:
        profile.position = line.position;
        profile.positionLine = line.line;
        break;
    case EProfileLine::FrameRate:
        profile.frameRate = line.frameRate;
        profile.frameRateLine = line.line;
        break;
    case EProfileLine::Fixed:
    case EProfileLine::Mapping:
        profile.rows.AddRow(line.source, line.target, line.Numbers(), ERowColumns::All);
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
    for (ProfileLine line; reader.Next(line);)
        TakeLine(line, profile);
    profile.rows.AddPelvisRows();
    return profile;
}

std::optional<size_t> RowsThatMayFit(std::string_view text, const CBoneNames& sources)
{
    CProfileReader reader(text);
    std::vector<std::string_view> targets;
    const auto isKnown = [&](std::string_view target) {
        return std::ranges::any_of(targets,
                                   [&](std::string_view known) { return EqualNoCase(known, target); });
    };
    bool allFit = true;
    for (ProfileLine line; reader.Next(line);)
    {
        if (line.kind != EProfileLine::Mapping && line.kind != EProfileLine::Fixed)
            continue;
        if (allFit && !EqualNoCase(line.source, kFixedSource) && !sources.Find(line.source))
        {
            if (!isKnown(line.target)) // a second row for the same target does not change its source
                return std::nullopt;
            allFit = false;
        }
        targets.push_back(line.target);
    }
    const auto added = std::ranges::count_if(kPelvisBones, std::not_fn(isKnown));
    return targets.size() + static_cast<size_t>(added);
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

} // namespace gw
