// Writes a motion that was read in its own format, and reads it again.

#include "FuzzTarget.h"
#include "MotionPromises.h"
#include "TKBVHStream.h"

void gw::FuzzOne(std::span<const std::byte> input)
{
    CMotionFile motion;
    if (!motion.Load(ScratchFile("in.bvh", input)))
        return;
    RequireSoundMotion(motion);
    TKBVHStream writer(motion);
    Require(writer.WriteFile(ScratchPath("out.bvh")), "what was read can be written");
    RequireSameBones(motion, "out.bvh");
}
