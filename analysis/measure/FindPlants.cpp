#include "FindPlants.h"

#include "CFeetTrack.h"

#include <span>

namespace gw {

std::vector<FootPlants> FindPlants(const CFeetTrack& feet, double secondsPerFrame)
{
    const float ankleFloor = FloorOf(feet.Legs(), &CLegTrack::Ankles);
    const float toeFloor = FloorOf(feet.Legs(), &CLegTrack::Toes);
    const auto find = [&](std::span<const FloorPath> joints) {
        return FindContacts(joints, feet.LegLength(), secondsPerFrame);
    };
    std::vector<FootPlants> plants;
    for (const CLegTrack& leg : feet.Legs())
    {
        const FloorPath joints[] = {
            {leg.Ankles(), ankleFloor},
            {leg.Toes(),   toeFloor  }
        };
        const std::span<const FloorPath> both(joints);
        if (leg.HasToe())
            plants.push_back({find(both), find(both.first(1)), find(both.last(1))});
        else
            plants.push_back({find(both.first(1)), find(both.first(1)), {}});
    }
    return plants;
}

} // namespace gw
