// The older skin: entries are stored per point, and each point is transformed once per bone. The points
// stay in file order until Link has resolved their ids, and are then sorted by index.

#include "CSkinBoneControl.h"

#include "CFieldArchive.h"
#include "CGeometry.h"
#include "SkinBones.h"

#include <algorithm>
#include <iterator>
#include <mutex>
#include <utility>

namespace gw {

const CRTTI CSkinBoneControl::ms_kRTTI{"CSkinBoneControl", &CControl::ms_kRTTI};

namespace {

// Scratch space for points: shared by all skins, by one at a time, and kept between updates.
std::mutex s_kScratchMutex;
std::vector<Vec3> s_kScratch;

// Returns the scratch space with room for so many points, all zero. The caller holds its mutex.
std::vector<Vec3>& Scratch(size_t count)
{
    s_kScratch.resize(std::max(s_kScratch.size(), count));
    std::ranges::fill(s_kScratch, kVec3Zero);
    return s_kScratch;
}

} // namespace

CSkinBoneControl::CSkinBoneControl() = default;
CSkinBoneControl::CSkinBoneControl(const CSkinBoneControl& source) = default;
CSkinBoneControl::~CSkinBoneControl() = default;

CObject* CSkinBoneControl::CreateClone() const
{
    return new CSkinBoneControl(*this);
}

void CSkinBoneControl::Fields(CFieldArchive& archive)
{
    CControl::Fields(archive);
    archive.Array("m_kPoints", m_kPoints, [](CFieldArchive& points, Point& point) {
        points.Unsigned("m_uiIndex", point.m_uiIndex);
        points.Array("m_kEntries", point.m_kEntries, [](CFieldArchive& entries, Entry& entry) {
            entries.PlainLink("m_pkBone", entry.m_pkBone);
            entries.Float("m_fWeight", entry.m_fWeight);
            entries.Matrix("m_kOffset", entry.m_kOffset);
        });
    });
}

uint64_t CSkinBoneControl::GetMemoryUsed() const
{
    uint64_t bytes = CControl::GetMemoryUsed() + 12;
    for (const Point& point : m_kPoints)
        bytes += 16 + point.m_kEntries.size() * 72;
    return bytes;
}

// Link ids are resolved in file order, so points are sorted afterwards.
void CSkinBoneControl::Link(COrrinStream& stream, CLinkRecord& record)
{
    CControl::Link(stream, record);
    SortPoints();
}

void CSkinBoneControl::SortPoints()
{
    std::ranges::stable_sort(m_kPoints, {}, &Point::m_uiIndex);
    std::vector<Point> points;
    for (Point& point : m_kPoints)
    {
        if (points.empty() || points.back().m_uiIndex != point.m_uiIndex)
            points.push_back(std::move(point));
        else
            std::ranges::move(point.m_kEntries, std::back_inserter(points.back().m_kEntries));
    }
    m_kPoints = std::move(points);
}

void CSkinBoneControl::AddInfluence(CSpatial& bone, uint32_t point, float weight, const Mat4& offset)
{
    auto place = std::ranges::lower_bound(m_kPoints, point, {}, &Point::m_uiIndex);
    if (place == m_kPoints.end() || place->m_uiIndex != point)
        place = m_kPoints.insert(place, Point{point, {}});
    Entry& entry = *place->m_kEntries.emplace(place->m_kEntries.begin());
    entry.m_pkBone.Set(&bone);
    entry.m_fWeight = weight;
    entry.m_kOffset = offset;
}

bool CSkinBoneControl::Bind(CObject& root)
{
    CControl::Bind(root);
    CBonesByName bones(root);
    const std::vector<Point> old = std::exchange(m_kPoints, {});
    for (const Point& point : old)
    {
        for (const Entry& entry : point.m_kEntries)
        {
            if (CSpatial* bone = bones.Find(entry.m_pkBone.Get()))
                AddInfluence(*bone, point.m_uiIndex, entry.m_fWeight, entry.m_kOffset);
        }
    }
    return true;
}

bool CSkinBoneControl::Rebind(const CCloneMap& map)
{
    CControl::Rebind(map);
    const CCopies copies(map);
    for (Point& point : m_kPoints)
        std::erase_if(point.m_kEntries,
                      [&](const Entry& entry) { return !copies.Contains(entry.m_pkBone.Get()); });
    return true;
}

Vec3 CSkinBoneControl::Blend(const Point& point, const Vec3& model) const
{
    Vec3 sum = kVec3Zero;
    for (const Entry& entry : point.m_kEntries)
    {
        if (!entry.m_pkBone)
            continue;
        const Vec3 inBone = TransformCoord(model, entry.m_kOffset);
        sum = sum + TransformCoord(inBone, entry.m_pkBone->m_kWorldMatrix) * entry.m_fWeight;
    }
    return sum;
}

bool CSkinBoneControl::Update(float)
{
    CGeometry* target = RecordCast<CGeometry>(GetTarget());
    if (!m_bActive || !target)
        return false;
    if (!target->m_bWorldValid)
        target->UpdateWorldPoints();
    const std::span<Vec3> points = target->WorldXYZBuffer();
    const Mat4 toModel = Mat4InverseOrIdentity(target->m_kWorldMatrix);
    const std::scoped_lock lock(s_kScratchMutex);
    std::vector<Vec3>& moved = Scratch(points.size());
    for (const Point& point : m_kPoints)
    {
        if (point.m_uiIndex < points.size())
            moved[point.m_uiIndex] =
                moved[point.m_uiIndex] + Blend(point, TransformCoord(points[point.m_uiIndex], toModel));
    }
    std::copy_n(moved.begin(), points.size(), points.begin());
    ++target->m_uiChangeStamp;
    return true;
}

} // namespace gw
