// Reads a motion of matrices in text form.

#include "FuzzTarget.h"
#include "MotionPromises.h"

void gw::FuzzOne(std::span<const std::byte> input)
{
    CMotionFile motion;
    if (motion.Load(ScratchFile("in.cha", input)))
        RequireSoundMotion(motion);
}
