#include "CheckJoints.h"

#include "BVHOutline.h"
#include "CFindings.h"
#include "TKBVHFile.h"

#include <algorithm>
#include <string_view>
#include <unordered_set>
#include <vector>

namespace gw {

namespace {

void LookForSameNames(const BVHOutline& outline, CFindings& findings)
{
    std::unordered_set<std::string_view> names;
    for (const OutlineJoint& joint : outline.joints)
    {
        if (!joint.name.empty() && !names.insert(joint.name).second)
            findings.Add(EFailure::SameName, joint.line, joint.name);
    }
}

// Returns nothing for a joint with an unknown channel.
std::vector<int> RotationOrder(const OutlineJoint& joint)
{
    if (std::ranges::count(joint.channels, OutlineJoint::kNoChannel) > 0)
        return {};
    std::vector<int> order = joint.channels;
    std::erase_if(order, [](int channel) { return channel < kFirstRotation || channel >= kFirstScale; });
    return order;
}

// The root's positions may differ from other joints'; only rotation orders are reported.
void LookForMixedChannels(const BVHOutline& outline, CFindings& findings)
{
    std::vector<int> usual;
    for (const OutlineJoint& joint : outline.joints)
    {
        const std::vector<int> order = RotationOrder(joint);
        if (usual.empty())
            usual = order;
        if (!order.empty() && order != usual)
            return findings.Add(EFailure::MixedChannels, joint.line, joint.name);
    }
}

} // namespace

void CheckJoints(const BVHOutline& outline, CFindings& findings)
{
    LookForSameNames(outline, findings);
    LookForMixedChannels(outline, findings);
}

} // namespace gw
