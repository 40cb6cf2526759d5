// Writes a motion with its rest pose in its own format, and reads it again.

#include "FuzzTarget.h"
#include "MotionPromises.h"

void gw::FuzzOne(std::span<const std::byte> input)
{
    CMotionFile motion;
    if (!motion.Load(ScratchFile("in.htr", input)))
        return;
    RequireSoundMotion(motion);
    // The frame count is used as it is, so a single line can produce a file of many megabytes.
    if (motion.GetLastFrame() > static_cast<float>(input.size()))
        return;
    Require(motion.Save(ScratchPath("out.htr"), 1.0f), "what was read can be written");
    if (HasPlainNames(motion))
        RequireSameBones(motion, "out.htr");
}
