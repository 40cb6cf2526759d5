#include "TurnedBones.h"

#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "CPoseMatcher.h"
#include "CPoseSampler.h"
#include "CRetargeter.h"
#include "Directions.h"
#include "HostBones.h"
#include "Skeleton.h"

namespace gw {

namespace {

constexpr double kTurned = 40.0; // in degrees: an A-pose's legs and bent knees are below, a wrong frame is 90

struct BoneRow
{
    const char* name;
    bool planted; ///< planting aligns it with the source's, so only its twist matters
};
constexpr BoneRow kBones[] = {
    {kTorsoBone,           false},
    {kNeckBone,            false},
    {kLeftBones.upperArm,  false},
    {kLeftBones.forearm,   false},
    {kRightBones.upperArm, false},
    {kRightBones.forearm,  false},
    {kLeftBones.thigh,     true },
    {kLeftBones.calf,      true },
    {kRightBones.thigh,    true },
    {kRightBones.calf,     true },
};

Mat3 RestBone(const CNode& source)
{
    const CBoneMesh* const mesh = FindBoneMesh(source);
    const Mat4 world = RestWorld(source);
    return NormalizedRows(mesh ? mesh->m_kMatrix * world : world);
}

} // namespace

std::vector<TurnedBone> FindTurnedBones(const CRetargeter& table, CNode& targetRoot)
{
    std::vector<TurnedBone> bones;
    const CNodeNames names(targetRoot);
    for (const auto& [name, planted] : kBones)
    {
        const CNode* const target = names.Find(name);
        const CNode* const source = table.SourceOf(target);
        if (!target || !source)
            continue;
        const Mat3 offset = OffsetRotation(table.OffsetAngles(target), table.OffsetMatrix(target));
        const Mat3 rest = NormalizedRows(RestWorld(*target));
        const Mat3 turned = offset * RestBone(*source);
        const Mat3 swing = planted ? LeastSwing(turned.Row(1), rest.Row(1)) : kMat3Identity;
        const double degrees = AngleOf(turned * swing * Mat3Transpose(rest));
        if (degrees > kTurned)
            bones.push_back({name, std::string(source->NameView()), degrees});
    }
    return bones;
}

} // namespace gw
