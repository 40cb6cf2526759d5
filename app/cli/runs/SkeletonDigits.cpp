#include "SkeletonDigits.h"

#include "CContentHash.h"
#include "CNode.h"
#include "CStances.h"
#include "SourceTiming.h"
#include "Vec3.h"

namespace gw {

// Relative to the root, whose own place often differs from take to take.
std::string SkeletonDigits(CNode& root)
{
    const CStances stances(root);
    std::string places = std::to_string(ProfileRateOf(&root));
    for (int joint = 0; joint < static_cast<int>(stances.Joints().size()); ++joint)
    {
        const CNode* const node = stances.Joints()[static_cast<size_t>(joint)];
        const Vec3 place = stances.Place(0, joint) - stances.Place(0, 0);
        places += '\n';
        places += node->NameView();
        places += ' ' + std::to_string(stances.IndexOf(dynamic_cast<const CNode*>(node->GetParent())));
        for (const float coordinate : {place.x, place.y, place.z})
            places += ' ' + std::to_string(coordinate);
    }
    return CContentHash().AddText(places).Digits();
}

} // namespace gw
