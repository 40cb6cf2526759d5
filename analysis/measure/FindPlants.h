#pragma once

#include "FindContacts.h"

#include <vector>

namespace gw {

class CFeetTrack;

/// The frames in which one foot of a skeleton stands, and in which each of its joints does.
struct FootPlants
{
    std::vector<Contact> foot;  ///< ankle and toe together; see FindContacts.h
    std::vector<Contact> ankle; ///< only the ankle
    std::vector<Contact> toe;   ///< only the toe; empty without a toe joint
};

/// Returns the plants of each leg. The floor of a joint is the level on which both feet's joints of that kind
/// stand.
std::vector<FootPlants> FindPlants(const CFeetTrack& feet, double secondsPerFrame);

} // namespace gw
