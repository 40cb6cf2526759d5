#include "MotionPromises.h"

#include "FuzzTarget.h"
#include "Skeleton.h"

#include <algorithm>
#include <set>

namespace gw {

namespace {

std::string_view NameOf(const CNode* bone)
{
    const std::string_view name = bone->NameView();
    return name.substr(0, name.find_last_not_of('\r') + 1);
}

} // namespace

void RequireSoundMotion(CMotionFile& motion)
{
    Require(motion.motionRoot.Get() != nullptr, "a motion that was read has a tree");
    Require(!motion.Record().Failure(), "a motion that was read has no failure");
    const float end = motion.GetLastFrame() * motion.GetFrequency();
    for (const float time : {0.5f * end, end, -1.0f, 2.0f * end})
        motion.motionRoot->UpdateScene(time, true);
}

bool HasPlainNames(const CMotionFile& motion)
{
    std::set<std::string_view> names;
    return std::ranges::all_of(NodesOf(*motion.motionRoot), [&](const CNode* bone) {
        const std::string_view name = NameOf(bone);
        return names.insert(name).second && name != "GLOBAL" && name.find_first_of("[]#, \t\r") == name.npos;
    });
}

void RequireSameBones(const CMotionFile& motion, std::string_view scratchName)
{
    CMotionFile again;
    Require(again.Load(ScratchPath(scratchName)), "what was written can be read");
    Require(std::ranges::equal(NodesOf(*motion.motionRoot), NodesOf(*again.motionRoot), {}, NameOf, NameOf),
            "what was written has the same bones");
}

} // namespace gw
