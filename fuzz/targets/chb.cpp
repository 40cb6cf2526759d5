// Reads a motion of matrices in binary form.

#include "FuzzTarget.h"
#include "MotionPromises.h"

void gw::FuzzOne(std::span<const std::byte> input)
{
    CMotionFile motion;
    if (motion.Load(ScratchFile("in.chb", input)))
        RequireSoundMotion(motion);
}
