// A motion with its rest pose, written as one of its own kind and read again.

#include "FuzzTarget.h"
#include "MotionPromises.h"

void gw::FuzzOne(std::span<const std::byte> input)
{
    CMotionFile motion;
    if (!motion.Load(ScratchFile("in.htr", input)))
        return;
    RequireSoundMotion(motion);
    // A count of frames is taken at its word, so that a line may ask for a file of many megabytes.
    if (motion.GetLastFrame() > static_cast<float>(input.size()))
        return;
    Require(motion.Save(ScratchPath("out.htr"), 1.0f), "what was read can be written");
    if (HasPlainNames(motion))
        RequireSameBones(motion, "out.htr");
}
