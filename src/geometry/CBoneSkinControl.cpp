// Skinning. Files store influences by bone, but points are transformed one by one, so RebuildSkinTables sorts
// the influences by point once and groups the points by their number of influences. Each update blends the
// matrices of a point's bones and transforms the point once.

#include "CBoneSkinControl.h"

#include "CFieldArchive.h"
#include "CGeometry.h"
#include "SkinBones.h"

#include <algorithm>

namespace gw {

const CRTTI CBoneSkinControl::ms_kRTTI{"CBoneSkinControl", &CControl::ms_kRTTI};

namespace {

// All sixteen elements: if weights sum to more than 1, the fourth coordinate divides the point.
void AddScaled(Mat4& sum, const Mat4& matrix, float weight)
{
    for (size_t i = 0; i < std::size(sum.m); ++i)
        sum.m[i] += weight * matrix.m[i];
}

// The remainder of the weights up to 1 goes to the mesh's own matrix.
Mat4 Blend(const CSkinPointRecord& point, std::span<const Mat4> matrices, const Mat4& world)
{
    Mat4 blend = kMat4Zero;
    float sum = 0.0f;
    for (size_t i = 0; i < point.places.size(); ++i)
    {
        sum += point.weights[i];
        AddScaled(blend, matrices[point.places[i]], point.weights[i]);
    }
    if (!(sum >= 1.0f))
        AddScaled(blend, world, 1.0f - sum);
    return blend;
}

void MovePoints(std::span<const CSkinPointRecord> records, std::span<const Mat4> matrices, const Mat4& world,
                std::span<Vec3> points)
{
    for (const CSkinPointRecord& record : records)
        points[record.point] = TransformCoord(points[record.point], Blend(record, matrices, world));
}

} // namespace

CBoneSkinControl::CBoneSkinControl() = default;
CBoneSkinControl::CBoneSkinControl(const CBoneSkinControl& source)
    : CControl(source), m_kBones(source.m_kBones)
{
}
CBoneSkinControl::~CBoneSkinControl() = default;

CObject* CBoneSkinControl::CreateClone() const
{
    return new CBoneSkinControl(*this);
}

void CBoneSkinControl::Fields(CFieldArchive& archive)
{
    CControl::Fields(archive);
    archive.Array("m_kBones", m_kBones, [](CFieldArchive& bones, CSkinBoneRecord& record) {
        bones.PlainLink("m_pkBone", record.m_pkBone);
        bones.Matrix("m_kOffset", record.m_kOffset);
        bones.Array("m_kInfluences", record.m_kInfluences, [](CFieldArchive& pairs, SkinInfluence& pair) {
            pairs.Unsigned("SkinID", pair.SkinID);
            pairs.Float("SkinWeight", pair.SkinWeight);
        });
    });
}

void CBoneSkinControl::Link(COrrinStream& stream, CLinkRecord& record)
{
    CControl::Link(stream, record);
    RebuildSkinTables();
}

uint64_t CBoneSkinControl::GetMemoryUsed() const
{
    constexpr size_t kInfluenceBytes = sizeof(void*) + sizeof(float) + sizeof(uint32_t);
    uint64_t bytes = CControl::GetMemoryUsed() + 36 + m_kPoints.size() * sizeof(CSkinPointRecord) +
                     m_kPointBones.size() * kInfluenceBytes;
    for (const auto& row : m_kGroups)
        bytes += row.size() * sizeof(SkinPointRun);
    for (const CSkinBoneRecord& record : m_kBones)
        bytes += 80 + record.m_kInfluences.size() * sizeof(SkinInfluence);
    return bytes;
}

CSkinBoneRecord& CBoneSkinControl::RecordOf(CSpatial& bone, const Mat4& offset)
{
    const auto isBone = [&](const CSkinBoneRecord& record) { return record.m_pkBone.Get() == &bone; };
    const auto known = std::ranges::find_if(m_kBones, isBone);
    if (known != m_kBones.end())
        return *known;
    CSkinBoneRecord& record = m_kBones.emplace_back();
    record.m_pkBone.Set(&bone);
    record.m_kOffset = offset;
    return record;
}

void CBoneSkinControl::AddInfluence(CSpatial& bone, uint32_t point, float weight, const Mat4& offset)
{
    std::vector<SkinInfluence>& influences = RecordOf(bone, offset).m_kInfluences;
    influences.insert(influences.begin(), {point, weight});
}

std::vector<CSpatial*> CBoneSkinControl::CurrentBones() const
{
    std::vector<CSpatial*> bones(m_kBones.size());
    std::ranges::transform(m_kBones, bones.begin(),
                           [](const CSkinBoneRecord& record) { return record.m_pkBone.Get(); });
    return bones;
}

// Returns the effective influences sorted by point, then in bone order.
std::vector<CBoneSkinControl::Influence> CBoneSkinControl::SortedInfluences() const
{
    std::vector<Influence> influences;
    for (uint32_t place = 0; place < m_kBones.size(); ++place)
    {
        if (!m_kTableBones[place])
            continue;
        for (const SkinInfluence& influence : m_kBones[place].m_kInfluences)
        {
            if (influence.SkinWeight != 0.0f && influence.SkinID < m_uiTablePoints)
                influences.push_back({influence.SkinID, place, influence.SkinWeight});
        }
    }
    std::ranges::stable_sort(influences, {}, &Influence::point);
    return influences;
}

void CBoneSkinControl::AddToGroup(size_t influences, uint32_t begin, uint32_t end)
{
    if (begin == end)
        return;
    m_kGroups.resize(std::max(m_kGroups.size(), influences + 1));
    std::vector<SkinPointRun>& row = m_kGroups[influences];
    if (!row.empty() && row.back().end == begin)
        row.back().end = end;
    else
        row.push_back({begin, end, m_kPoints.size()});
}

void CBoneSkinControl::RebuildSkinTables()
{
    CGeometry* target = RecordCast<CGeometry>(GetTarget());
    m_uiTablePoints = target ? target->WorldXYZBuffer().size() : 0;
    m_kTableBones = CurrentBones();
    const std::vector<Influence> influences = SortedInfluences();
    m_kPointBones.resize(influences.size());
    m_kPointWeights.resize(influences.size());
    m_kPointPlaces.resize(influences.size());
    for (size_t i = 0; i < influences.size(); ++i)
    {
        m_kPointBones[i] = m_kTableBones[influences[i].place];
        m_kPointWeights[i] = influences[i].weight;
        m_kPointPlaces[i] = influences[i].place;
    }

    m_kPoints.clear();
    m_kGroups.assign(1, {});
    uint32_t next = 0; // the first point that is not yet in a group
    for (size_t first = 0; first < influences.size();)
    {
        const uint32_t point = influences[first].point;
        size_t count = 1;
        while (first + count < influences.size() && influences[first + count].point == point)
            ++count;
        AddToGroup(0, next, point);
        AddToGroup(count, point, point + 1);
        next = point + 1;
        m_kPoints.push_back({point, std::span(m_kPointBones).subspan(first, count),
                             std::span(m_kPointWeights).subspan(first, count),
                             std::span(m_kPointPlaces).subspan(first, count)});
        first += count;
    }
    AddToGroup(0, next, static_cast<uint32_t>(m_uiTablePoints));
}

bool CBoneSkinControl::AreTablesCurrent(size_t pointCount) const
{
    const auto isSame = [](const CSkinBoneRecord& record, const CSpatial* bone) {
        return record.m_pkBone.Get() == bone;
    };
    return !m_kGroups.empty() && pointCount == m_uiTablePoints &&
           std::ranges::equal(m_kBones, m_kTableBones, isSame);
}

bool CBoneSkinControl::Bind(CObject& root)
{
    CControl::Bind(root);
    CBonesByName bones(root);
    const std::vector<CSkinBoneRecord> old = std::exchange(m_kBones, {});
    for (const CSkinBoneRecord& record : old)
    {
        CSpatial* bone = bones.Find(record.m_pkBone.Get());
        if (!bone)
            continue;
        // As if they were added one by one, each before the others.
        std::vector<SkinInfluence>& influences = RecordOf(*bone, record.m_kOffset).m_kInfluences;
        influences.insert(influences.begin(), record.m_kInfluences.rbegin(), record.m_kInfluences.rend());
    }
    RebuildSkinTables();
    return true;
}

bool CBoneSkinControl::Rebind(const CCloneMap& map)
{
    CControl::Rebind(map);
    const CCopies copies(map);
    std::erase_if(m_kBones,
                  [&](const CSkinBoneRecord& record) { return !copies.Contains(record.m_pkBone.Get()); });
    RebuildSkinTables();
    return true;
}

std::vector<Mat4> CBoneSkinControl::SkinMatrices(const Mat4& before) const
{
    std::vector<Mat4> matrices;
    matrices.reserve(m_kBones.size());
    for (const CSkinBoneRecord& record : m_kBones)
        matrices.push_back(record.m_pkBone ? before * record.m_kOffset * record.m_pkBone->m_kWorldMatrix
                                           : kMat4Identity);
    return matrices;
}

bool CBoneSkinControl::Update(float)
{
    CGeometry* target = RecordCast<CGeometry>(GetTarget());
    if (!m_bActive || !target)
        return false;
    const std::span<Vec3> points = target->WorldXYZBuffer();
    if (!AreTablesCurrent(points.size()))
        RebuildSkinTables();
    const Mat4& world = target->m_kWorldMatrix;
    // If a previous control has moved the points to world space, transform them back to model space first.
    const std::vector<Mat4> matrices =
        SkinMatrices(target->m_bWorldValid ? Mat4InverseOrIdentity(world) : kMat4Identity);
    for (const SkinPointRun& run : m_kGroups.front())
    {
        for (uint32_t point = run.begin; point < run.end; ++point)
            points[point] = TransformCoord(points[point], world);
    }
    for (size_t group = 1; group < m_kGroups.size(); ++group)
    {
        for (const SkinPointRun& run : m_kGroups[group])
            MovePoints(std::span(m_kPoints).subspan(run.record, run.end - run.begin), matrices, world,
                       points);
    }
    target->m_bWorldValid = true;
    ++target->m_uiChangeStamp;
    return true;
}

} // namespace gw
