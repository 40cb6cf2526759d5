// Computes the scale from source to target as the ratio of hip height plus leg length. Two walkers climb from
// both feet toward the hips; the left one measures the leg, and the midpoint between the two is the pelvis.
// The ratio is then corrected for the difference between the target's proportions and the usual ones, which
// are not the same for legs with and without extra joints.

#include "CRetargeter.h"
#include "HostBones.h"
#include "Skeleton.h"

#include <algorithm>

namespace gw {

namespace {

// Usual proportions of the target family, and the correction factor for deviating from them.
constexpr float kLongNorm = 8.5f;
constexpr float kLongBend = 0.0075f;
constexpr float kShortNorm = 5.1f;
constexpr float kShortBend = 0.007f;
constexpr float kFootRiseLength = 10.0f;
constexpr float kFootRiseFactor = 0.0032707655f;

double SecondRowLength(const CSpatial* node)
{
    return node ? Vec3Length(node->m_kWorldMatrix.Row(1)) : 1.0;
}

// Counts the links of a target leg from the foot's parent up to, but not including, the pelvis bone or root.
int TargetLinks(const CNode* foot)
{
    int links = 0;
    for (const CNode* node = foot->GetParentNode(); node; node = node->GetParentNode())
    {
        if (node->NameView() == kLeftBones.pelvis || node->NameView() == kRootBone)
            break;
        ++links;
    }
    return links;
}

// Counts the links of a source leg from the foot up to, but not including, the thigh.
int SourceLinks(const CNode* foot, const CNode* thigh)
{
    int links = 1;
    for (const CNode* node = foot->GetParentNode(); node && node != thigh; node = node->GetParentNode())
        ++links;
    return links;
}

// Two walkers that climb from both feet in parallel; the left one measures.
struct LegWalk
{
    const CNode* left;
    const CNode* right;
    double length = 0.0;

    void Climb()
    {
        length += Vec3Length(left->m_kMatrix.Translation()) * SecondRowLength(left->GetParent());
        if (left->GetParentNode())
            left = left->GetParentNode();
        if (right->GetParentNode())
            right = right->GetParentNode();
    }
    double PelvisHeight(const CNode& hip) const
    {
        const Vec3 middle = (left->m_kWorldMatrix.Translation() + right->m_kWorldMatrix.Translation()) * 0.5f;
        return Vec3Length(middle - hip.m_kWorldMatrix.Translation());
    }
};

} // namespace

void CRetargeter::MeasureBody(float& scale, float& footRise, float weight) const
{
    if (!m_pkTargetRoot)
        return;
    const CNodeNames names(*m_pkTargetRoot);
    const CNode* torso = names.Find(kRootBone);
    const CNode* leftFoot = names.Find(kLeftBones.foot);
    const CNode* rightFoot = names.Find(kRightBones.foot);
    const CNode* leftThigh = names.Find(kLeftBones.thigh);
    const CNode* sourceHip = SourceOf(m_pkTargetRoot);
    const CNode* sourceLFoot = SourceOf(leftFoot);
    const CNode* sourceRFoot = SourceOf(rightFoot);
    const CNode* sourceLThigh = SourceOf(leftThigh);
    if (!torso || !sourceHip || !sourceLFoot || !sourceRFoot || !sourceLThigh)
        return;

    const int targetLinks = TargetLinks(leftFoot);
    const int sourceLinks = SourceLinks(sourceLFoot, sourceLThigh);
    LegWalk target{leftFoot, rightFoot};
    LegWalk source{sourceLFoot, sourceRFoot};
    for (int i = 0; i < std::max(targetLinks, sourceLinks); ++i)
    {
        if (i < targetLinks)
            target.Climb();
        if (i < sourceLinks)
            source.Climb();
    }
    footRise =
        static_cast<float>((target.length + kFootRiseLength * SecondRowLength(leftFoot)) * kFootRiseFactor);

    const double targetPelvis = target.PelvisHeight(*torso);
    const double sourcePelvis = source.PelvisHeight(*sourceHip);
    const double proportion = target.length / targetPelvis;
    const double bend = targetLinks > 2 ? (proportion - kLongNorm) * weight * kLongBend
                                        : (proportion - kShortNorm) * weight * kShortBend;
    scale =
        static_cast<float>((targetPelvis + target.length) * (1.0 + bend) / (sourcePelvis + source.length));
}

} // namespace gw
