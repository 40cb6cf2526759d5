#include "CBoneSkinControl.h"

#include "CFieldArchive.h"
#include "CGeometry.h"
#include "SkinBones.h"

#include <algorithm>

namespace gw {

const CRTTI CBoneSkinControl::ms_kRTTI{"CBoneSkinControl", &CControl::ms_kRTTI};

namespace {

// All sixteen elements: where weights sum to more than 1, the fourth result divides the point.
void AddScaled(Mat4& sum, const Mat4& matrix, float weight)
{
    for (size_t i = 0; i < std::size(sum.m); ++i)
        sum.m[i] += weight * matrix.m[i];
}

// A point that no bone moves goes with the mesh, and so does what its weights lack.
Mat4 Blend(std::span<const CSkinPointRecord> influences, std::span<const Mat4> matrices, const Mat4& world)
{
    if (influences.empty())
        return world;
    Mat4 blend = kMat4Zero;
    float sum = 0.0f;
    for (const CSkinPointRecord& influence : influences)
    {
        sum += influence.weight;
        AddScaled(blend, matrices[influence.bone], influence.weight);
    }
    if (!(sum >= 1.0f))
        AddScaled(blend, world, 1.0f - sum);
    return blend;
}

} // namespace

CBoneSkinControl::CBoneSkinControl() = default;
CBoneSkinControl::CBoneSkinControl(const CBoneSkinControl& source) = default;
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
        bones.Array("m_kInfluences", record.m_kInfluences, [](CFieldArchive& pairs, CSkinInfluence& pair) {
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
    uint64_t bytes = CControl::GetMemoryUsed() + 36 + m_kPoints.size() * sizeof(CSkinPointRecord);
    for (const CSkinBoneRecord& record : m_kBones)
        bytes += 80 + record.m_kInfluences.size() * sizeof(CSkinInfluence);
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
    std::vector<CSkinInfluence>& influences = RecordOf(bone, offset).m_kInfluences;
    influences.insert(influences.begin(), {point, weight});
}

uint32_t CBoneSkinControl::LiveBones() const
{
    const auto isLive = [](const CSkinBoneRecord& record) { return static_cast<bool>(record.m_pkBone); };
    return static_cast<uint32_t>(std::ranges::count_if(m_kBones, isLive));
}

void CBoneSkinControl::RebuildSkinTables()
{
    m_kPoints.clear();
    for (uint32_t bone = 0; bone < m_kBones.size(); ++bone)
    {
        if (!m_kBones[bone].m_pkBone)
            continue;
        for (const CSkinInfluence& influence : m_kBones[bone].m_kInfluences)
        {
            if (influence.SkinWeight != 0.0f)
                m_kPoints.push_back({influence.SkinID, bone, influence.SkinWeight});
        }
    }
    std::ranges::stable_sort(m_kPoints, {}, &CSkinPointRecord::point);
    m_uiLiveBones = LiveBones();
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
        // As if added one by one, each in front of the others.
        std::vector<CSkinInfluence>& influences = RecordOf(*bone, record.m_kOffset).m_kInfluences;
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

// Those of one point, from `next` on, which then stands behind them.
std::span<const CSkinPointRecord> CBoneSkinControl::TakeInfluences(size_t& next, uint32_t point) const
{
    const size_t first = next;
    while (next < m_kPoints.size() && m_kPoints[next].point == point)
        ++next;
    return std::span(m_kPoints).subspan(first, next - first);
}

bool CBoneSkinControl::Update(float)
{
    CGeometry* target = RecordCast<CGeometry>(GetTarget());
    if (!m_bActive || !target)
        return false;
    if (LiveBones() != m_uiLiveBones)
        RebuildSkinTables();
    const Mat4& world = target->m_kWorldMatrix;
    // Behind a control that has already put the points into the world they first go back to the model.
    const std::vector<Mat4> matrices =
        SkinMatrices(target->m_bWorldValid ? Mat4InverseOrIdentity(world) : kMat4Identity);
    const std::span<Vec3> points = target->WorldXYZBuffer();
    size_t next = 0;
    for (uint32_t point = 0; point < points.size(); ++point)
    {
        const auto influences = TakeInfluences(next, point);
        points[point] = TransformCoord(points[point], Blend(influences, matrices, world));
    }
    target->m_bWorldValid = true;
    ++target->m_uiChangeStamp;
    return true;
}

} // namespace gw
