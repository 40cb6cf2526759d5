#include "CSoleMeter.h"

#include "BodyPose.h"
#include "Directions.h"
#include "FindContacts.h"

#include <algorithm>

namespace gw {

namespace {

constexpr double kLeastStandSeconds = 0.2;
// A foot that rolls from heel to toe is flat in most of its standing frames; the others are left out.
constexpr double kStray = 20.0; // degrees
constexpr double kLeastAgreeing = 0.6;

Vec3 MeanOf(const std::vector<Vec3>& directions)
{
    Vec3 sum = kVec3Zero;
    for (const Vec3& direction : directions)
        sum = sum + direction;
    return Vec3Normalized(sum);
}

// Returns the mean without outliers; nothing if too many directions disagree.
std::optional<Vec3> AgreedMean(std::vector<Vec3> directions)
{
    const size_t count = directions.size();
    const Vec3 mean = MeanOf(directions);
    std::erase_if(directions, [&](const Vec3& d) { return AngleBetween(d, mean) > kStray; });
    if (static_cast<double>(directions.size()) < kLeastAgreeing * static_cast<double>(count))
        return std::nullopt;
    return MeanOf(directions);
}

} // namespace

CSoleMeter::CSoleMeter(const CBodyMap& body, const Mat3& worldTurn)
    : m_kWorldTurn(worldTurn), m_kUp(Turned(kVec3UnitY, Mat3Transpose(worldTurn)))
{
    for (const EBodySide side : kBodySides)
        m_kFeet[static_cast<size_t>(side)] = {body.Leg(side).foot, body.Leg(side).toe, {}, {}, {}};
}

void CSoleMeter::Add()
{
    for (Foot& foot : m_kFeet)
    {
        if (!foot.ankle)
            continue;
        foot.ankles.push_back(Turned(PlaceOf(*foot.ankle), m_kWorldTurn));
        foot.ups.push_back(LocalDirection(m_kUp, *foot.ankle));
        if (foot.toe)
            foot.toes.push_back(Turned(PlaceOf(*foot.toe), m_kWorldTurn));
    }
}

float CSoleMeter::FloorOf(std::vector<Vec3> Foot::*joint) const
{
    std::vector<float> heights;
    for (const Foot& foot : m_kFeet)
        std::ranges::transform(foot.*joint, std::back_inserter(heights), &Vec3::y);
    if (heights.empty())
        return 0.0f;
    const auto low =
        heights.begin() + static_cast<ptrdiff_t>(kFloorShare * static_cast<double>(heights.size()));
    std::ranges::nth_element(heights, low);
    return *low;
}

std::optional<Vec3> CSoleMeter::Normal(EBodySide side, double leg, double secondsPerFrame) const
{
    const Foot& foot = m_kFeet[static_cast<size_t>(side)];
    if (!foot.ankle || !(leg > 0.0))
        return std::nullopt;
    std::vector<FloorPath> joints{
        {foot.ankles, FloorOf(&Foot::ankles)}
    };
    if (foot.toe)
        joints.push_back({foot.toes, FloorOf(&Foot::toes)});
    std::vector<Vec3> standing;
    for (const Contact& contact : FindContacts(joints, leg, secondsPerFrame))
        standing.insert(standing.end(), foot.ups.begin() + contact.first, foot.ups.begin() + contact.end);
    if (static_cast<double>(standing.size()) * secondsPerFrame < kLeastStandSeconds)
        return std::nullopt;
    return AgreedMean(std::move(standing));
}

} // namespace gw
