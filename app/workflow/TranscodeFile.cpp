#include "TranscodeFile.h"

#include "BodyPaths.h"
#include "CMotionFile.h"
#include "FindBody.h"
#include "GlbFile.h"
#include "MotionFacts.h"
#include "Paths.h"
#include "TKBVHStream.h"
#include "UpAxis.h"

#include <cmath>

namespace gw {

namespace {

// The file's own unit, or the one that the body's legs suggest.
double MetersPerUnit(const CMotionFile& motion)
{
    const double unit = motion.imported.unitMeters;
    return unit > 0.0 ? unit : MetersOfUnit(RestLegLength(FindBody(*motion.motionRoot).body));
}

Vec3 UpAxisOf(const CMotionFile& motion)
{
    return FindUpAxis(FindBody(*motion.motionRoot).body, motion.GetFrequency(), motion.GetKeyCount());
}

} // namespace

const char* WhyNoBVH(const CMotionFile& motion)
{
    constexpr float kLeastFrameTime = 0.0000005f; // the frame time has six decimals
    if (motion.GetLastFrame() <= -1.0f)
        return "the motion has no frames, so there is nothing to write";
    if (!(motion.GetFrequency() >= kLeastFrameTime) || !std::isfinite(motion.GetFrequency()))
        return "the frame time is 0, or too small for the six digits of a .bvh, so the rate would be lost";
    return nullptr;
}

bool WriteTranscoded(CMotionFile& motion, const std::string& path, float frameScale, CFailureRecord& record)
{
    if (HasExtension(path, ".htr"))
        return motion.Save(path, frameScale) || record.Fail(motion.Record().Failure());
    if (HasExtension(path, ".glb"))
        return SaveGlb(motion, MetersPerUnit(motion), path, record, UpAxisOf(motion));
    TKBVHStream stream(motion);
    return stream.WriteFile(path) || record.Fail(stream.Record().Failure());
}

} // namespace gw
