#pragma once

#include "FindContacts.h"

#include <vector>

namespace gw {

class CFeetTrack;

/// When one foot of a skeleton stands, and when each of its joints does.
struct FootPlants
{
    std::vector<Contact> foot;  ///< ankle and toe together; see FindContacts.h
    std::vector<Contact> ankle; ///< the ankle, whatever the toe does
    std::vector<Contact> toe;   ///< the toe, whatever the ankle does; none without a toe joint
};

/// The plants of each leg. A joint's floor is the height on which those of both feet stand.
std::vector<FootPlants> FindPlants(const CFeetTrack& feet, double secondsPerFrame);

} // namespace gw
