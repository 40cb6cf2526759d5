#include "FigureSides.h"

#include "CNode.h"
#include "HostBones.h"

#include <algorithm>
#include <initializer_list>

namespace gw {

namespace {

bool IsOf(const HostSide& side, const std::string& bone)
{
    const auto names = {side.collar, side.upperArm, side.forearm, side.hand, side.pelvis,
                        side.thigh,  side.calf,     side.foot,    side.toe};
    return std::ranges::find(names, bone) != names.end();
}

EFigureSide SideOf(const std::string& target)
{
    if (IsOf(kLeftBones, target))
        return EFigureSide::Left;
    return IsOf(kRightBones, target) ? EFigureSide::Right : EFigureSide::Middle;
}

} // namespace

const char* FigureSideName(EFigureSide side)
{
    constexpr const char* kNames[] = {"middle", "left", "right"};
    return kNames[static_cast<size_t>(side)];
}

std::vector<EFigureSide> FigureSides(const std::vector<CNode*>& nodes, const std::vector<BoneMeasures>& bones,
                                     std::string BoneMeasures::*name)
{
    std::unordered_map<std::string, EFigureSide> named;
    for (const BoneMeasures& bone : bones)
    {
        // A source bone that drives bones of the trunk and of a side belongs to the side.
        EFigureSide& side = named.try_emplace(bone.*name, EFigureSide::Middle).first->second;
        side = std::max(side, SideOf(bone.target));
    }
    std::unordered_map<const CNode*, EFigureSide> known;
    std::vector<EFigureSide> sides;
    for (const CNode* node : nodes)
    {
        const auto mapped = named.find(std::string(node->NameView()));
        const auto parent = known.find(node->GetParentNode());
        const EFigureSide inherited = parent == known.end() ? EFigureSide::Middle : parent->second;
        sides.push_back(mapped == named.end() ? inherited : mapped->second);
        known[node] = sides.back();
    }
    return sides;
}

} // namespace gw
