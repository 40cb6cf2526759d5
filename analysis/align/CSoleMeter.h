#pragma once

#include "CBodyMap.h"
#include "CNode.h"

#include <array>
#include <optional>
#include <vector>

namespace gw {

/// Measures the soles' orientation in the spaces of their feet: while a foot stands, its sole is level.
class CSoleMeter
{
public:
    /// `worldTurn` rotates the motion so that Y is up.
    CSoleMeter(const CBodyMap& body, const Mat3& worldTurn);

    /// Adds the current pose as the next frame.
    void Add();
    /// Returns the sole's normal in the foot's space; nothing if the foot does not stand long enough or
    /// consistently.
    std::optional<Vec3> Normal(EBodySide side, double leg, double secondsPerFrame) const;

private:
    struct Foot
    {
        const CNode* ankle;
        const CNode* toe;
        std::vector<Vec3> ankles;
        std::vector<Vec3> toes;
        std::vector<Vec3> ups; // world up in the foot's space
    };

    float FloorOf(std::vector<Vec3> Foot::*joint) const;

    Mat3 m_kWorldTurn;
    Vec3 m_kUp;
    std::array<Foot, 2> m_kFeet;
};

} // namespace gw
