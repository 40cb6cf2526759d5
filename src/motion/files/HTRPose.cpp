#include "HTRPose.h"

#include "CKeyframeControl.h"
#include "CMotionFile.h"
#include "Euler.h"
#include "Quat.h"
#include "Skeleton.h"

#include <cmath>
#include <iterator>

namespace gw {

namespace {

constexpr const char* kOrder = "ZYX";
// Angle about Y in degrees. Below it, the usual angles are accurate to 0.001 degrees: in 32 bits, the arc
// sine and the quotients are off by 6e-8 / cos.
constexpr float kNearQuarterTurn = 89.5f;
constexpr float kMostOff = 1.7e-5f; // 0.001 degrees in radians: tolerance for each element of a matrix

bool IsNearQuarterTurn(const Vec3& degrees)
{
    return !(std::fabs(degrees.y) < kNearQuarterTurn);
}

bool IsSameTurn(const Mat3& a, const Mat3& b)
{
    for (size_t i = 0; i < std::size(a.m); ++i)
    {
        if (!(std::fabs(a.m[i] - b.m[i]) <= kMostOff))
            return false;
    }
    return true;
}

// Returns the usual angles if they read back as the same rotation, otherwise angles that do.
Vec3 ReadBackDegrees(const Mat4& local, const Vec3& degrees, const HTRBase& base)
{
    const Mat3 turn = NormalizedRows(local);
    const Mat3 baseTurn = EulerToMat3(kOrder, base.degrees);
    if (IsSameTurn(EulerToMat3(kOrder, degrees) * baseTurn, turn))
        return degrees;
    return EulerDegreesZYX(turn * Mat3Transpose(baseTurn));
}

float Rounded(float value)
{
    constexpr double kDecimals = 1e6;
    return std::isfinite(value)
               ? static_cast<float>(std::nearbyint(static_cast<double>(value) * kDecimals) / kDecimals)
               : 0.0f;
}

Vec3 Rounded(const Vec3& v)
{
    return {Rounded(v.x), Rounded(v.y), Rounded(v.z)};
}

// Returns the rotation that a reader gets from the angles in a row's text.
Quat ReadBack(const Mat3& turn, const HTRBase& base, EQuarterTurns quarterTurns)
{
    const HTRRow row = RowOf(Mat4Compose(turn, kVec3Zero), false, base, quarterTurns);
    return QuatFromMat3(EulerToMat3(kOrder, Rounded(row.degrees)) * EulerToMat3(kOrder, base.degrees));
}

void TakeWrittenKeys(CKeyframeControl& track, bool isRoot, const HTRBase& base, EQuarterTurns quarterTurns)
{
    constexpr float kNearOne = 0.99996f; // sine of kNearQuarterTurn
    for (Quat& key : track.m_kRotationKeys)
    {
        const Mat3 turn = QuatToMat3(key);
        if (!(std::fabs(turn.m[2]) < kNearOne))
            key = ReadBack(turn, base, quarterTurns);
    }
    if (!isRoot)
        track.m_kPositionKeys.assign(track.m_kPositionKeys.size(), base.translation);
}

} // namespace

HTRRow RowOf(const Mat4& local, bool isRoot, const HTRBase& base, EQuarterTurns quarterTurns)
{
    const double length = Vec3Length(local.Row(0));
    const Vec3 degrees = RowsToEulerDegrees(local, length);
    HTRRow row;
    if (isRoot)
        row.translation = local.Translation() - base.translation;
    row.degrees = degrees - base.degrees;
    if (quarterTurns == EQuarterTurns::ReadBack && IsNearQuarterTurn(degrees))
        row.degrees = ReadBackDegrees(local, row.degrees, base);
    row.scale = static_cast<float>(length);
    return row;
}

void TakeWrittenPoses(const CMotionFile& result)
{
    for (const CNode* bone : NodesOf(*result.restRoot))
    {
        CNode* const node = FindNode(result.motionRoot.Get(), bone->GetName());
        CKeyframeControl* const track = node ? RecordCast<CKeyframeControl>(node->GetControl()) : nullptr;
        if (!track)
            continue;
        const HTRBase base{bone->m_kMatrix.Translation(),
                           Mat3ToEulerDegrees(NormalizedRows(bone->m_kMatrix))};
        TakeWrittenKeys(*track, !node->GetParent(), base, result.quarterTurns);
        track->m_kRestMatrix = bone->m_kMatrix;
    }
}

} // namespace gw
