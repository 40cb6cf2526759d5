#pragma once

#include "CBodyMap.h"
#include "CNode.h"

#include <array>
#include <optional>
#include <vector>

namespace gw {

/// How the soles lie in the spaces of their feet: while a foot stands, its sole is level.
class CSoleMeter
{
public:
    /// `worldTurn` turns the motion so that Y is up.
    CSoleMeter(const CBodyMap& body, const Mat3& worldTurn);

    /// Takes the present pose as the next frame.
    void Add();
    /// The sole's normal in the foot's space; none where the foot does not stand long enough, or stands this
    /// way and that.
    std::optional<Vec3> Normal(EBodySide side, double leg, double secondsPerFrame) const;

private:
    struct Foot
    {
        const CNode* ankle;
        const CNode* toe;
        std::vector<Vec3> ankles;
        std::vector<Vec3> toes;
        std::vector<Vec3> ups; // the world's up in the foot's space
    };

    float FloorOf(std::vector<Vec3> Foot::*joint) const;

    Mat3 m_kWorldTurn;
    Vec3 m_kUp;
    std::array<Foot, 2> m_kFeet;
};

} // namespace gw
