// Drafts a bone map from the body found in a source. Each host bone gets the source joint with the same role;
// CRowTurner computes its offset. Rows without a joint, or with a joint whose name a map cannot hold, are
// kept in the draft so that a user can see them, but not written to the map.

#include "SuggestProfile.h"

#include "CJointTree.h"
#include "CNode.h"
#include "CRowTurner.h"
#include "HostBones.h"
#include "ProfileNames.h"
#include "Text.h"

#include <algorithm>
#include <cmath>
#include <optional>

namespace gw {

namespace {

class CSuggester
{
public:
    CSuggester(CNode& sourceRoot, CNode& targetRoot)
        : m_kFound(FindBody(sourceRoot)), m_kTree(sourceRoot), m_kPoses(m_kTree, m_kFound.body),
          m_kTarget(targetRoot), m_kNames(&sourceRoot)
    {
    }

    SuggestedProfile Suggest() const;

private:
    CNode* SourceOf(size_t index) const;
    CNode* LowerSpine() const;
    bool CanName(const CNode* node) const;
    SuggestedRow MakeRow(size_t index) const;
    void Judge(SuggestedRow& row) const;
    void AddNumbers(std::vector<SuggestedRow>& rows) const;

    FoundBody m_kFound;
    CJointTree m_kTree;
    CSourcePoses m_kPoses;
    CTargetBones m_kTarget;
    CBoneNames m_kNames;
};

SuggestedProfile CSuggester::Suggest() const
{
    SuggestedProfile profile;
    profile.sidesAreSure = m_kFound.sidesAreSure;
    profile.restIsStance = m_kPoses.StandsAtRest();
    profile.turnsFromRest = m_kPoses.Reference() == 0;
    for (const BodyPlace& place : BodyPlaces())
    {
        if (IsNeeded(place.joint) && !CanName(JointAt(m_kFound.body, place)))
            profile.missing.push_back(place);
    }
    for (size_t index = 0; index < kHostRowCount; ++index)
        profile.rows.push_back(MakeRow(index));
    if (m_kFound.body.DrivesBody())
        AddNumbers(profile.rows);
    std::erase_if(profile.rows, [&](const SuggestedRow& row) { return !m_kTarget.Has(row.target); });
    return profile;
}

// A profile cuts names at blanks, and uses the first of two equal names.
bool CSuggester::CanName(const CNode* node) const
{
    if (!node)
        return false;
    const std::string_view name = node->NameView();
    const bool isToken = !name.empty() && name.find_first_of(" ,\t\r\n") == name.npos && name.front() != '*';
    return isToken && m_kNames.Find(name) == node;
}

CNode* CSuggester::SourceOf(size_t index) const
{
    if (index == kWaistRow)
        return LowerSpine();
    return JointAt(m_kFound.body, {kHostRows[index].joint, kHostRows[index].side});
}

// Returns the spine joint at the height of the target's waist, a fifth of the way from hip to neck. Null for
// a spine of one joint, which drives the upper torso.
CNode* CSuggester::LowerSpine() const
{
    constexpr double kWaistShare = 0.19;
    const CBodyMap& body = m_kFound.body;
    if (body.spine.size() < 2)
        return nullptr;
    const auto boneTo = [&](const CNode* joint) { return m_kTree.Length(m_kTree.IndexOf(joint)); };
    std::vector<double> heights;
    double height = 0.0;
    for (const CNode* joint : body.spine)
        heights.push_back(height += boneTo(joint));
    if (const CNode* above = body.neck.empty() ? body.head : body.neck.front())
        height += boneTo(above);
    heights.pop_back(); // the last one drives the upper torso
    const auto distance = [&](double at) { return std::fabs(at - kWaistShare * height); };
    return body.spine[static_cast<size_t>(std::ranges::min_element(heights, {}, distance) - heights.begin())];
}

SuggestedRow CSuggester::MakeRow(size_t index) const
{
    const HostRow& host = kHostRows[index];
    SuggestedRow row;
    row.target = host.target;
    row.place = {host.joint, host.side};
    if (std::ranges::find(kPelvisBones, row.target) != std::end(kPelvisBones))
    {
        row.kind = ESuggestedRow::Fixed;
        return row;
    }
    row.source = SourceOf(index);
    if (!row.source)
        row.kind = ESuggestedRow::NoSource;
    else if (!CanName(row.source))
        row.kind = ESuggestedRow::NoName;
    else
        row.kind = host.aim == EHostAim::None ? ESuggestedRow::Neutral : ESuggestedRow::Turned;
    if (row.IsMapping())
        Judge(row);
    return row;
}

void CSuggester::Judge(SuggestedRow& row) const
{
    row.evidence = m_kFound.Evidence(row.place);
    for (const BodyDoubt& doubt : m_kFound.doubts)
    {
        if (doubt.place == row.place)
            row.doubts.push_back(doubt.kind);
    }
    const bool isSideGuessed = HasSides(row.place.joint) && !m_kFound.sidesAreSure;
    if (isSideGuessed || !row.doubts.empty() || row.evidence == EBodyEvidence::ShapeOnly)
        row.sureness = ERowSureness::Unsure;
    else
        row.sureness = row.evidence == EBodyEvidence::Both ? ERowSureness::Sure : ERowSureness::Likely;
}

void CSuggester::AddNumbers(std::vector<SuggestedRow>& rows) const
{
    RowJoints joints;
    for (size_t index = 0; index < kHostRowCount; ++index)
        joints[index] = rows[index].IsMapping() ? m_kTree.IndexOf(rows[index].source) : CJointTree::kNone;
    const CRowTurner turner(m_kTree, m_kPoses, m_kTarget, joints);
    for (size_t index = 0; index < kHostRowCount; ++index)
    {
        if (!rows[index].IsMapping())
            continue;
        rows[index].numbers = turner.Numbers(index);
        rows[index].nudged = turner.IsNudged(index);
        rows[index].restError = turner.RestError(index);
    }
}

} // namespace

CMapRowTable SuggestedProfile::Table() const
{
    CMapRowTable table;
    for (const SuggestedRow& row : rows)
    {
        if (row.IsMapping())
            table.AddRow(row.source->NameView(), row.target, row.numbers, ERowColumns::All);
        else if (row.kind == ESuggestedRow::Fixed)
            table.AddRow(kFixedSource, row.target, {}, ERowColumns::All);
    }
    return table;
}

SuggestedProfile SuggestProfile(CNode& sourceRoot, CNode& targetRoot)
{
    return CSuggester(sourceRoot, targetRoot).Suggest();
}

std::string SuggestedName(std::string_view stem)
{
    std::string name(stem);
    const auto separates = [](char c) { return c == '_' || static_cast<unsigned char>(c) < ' '; };
    std::ranges::replace_if(name, separates, ' ');
    name = CutTrailing(FirstCharacters(name, kProfileNameLimit));
    return name.empty() ? "Suggested" : name;
}

} // namespace gw
