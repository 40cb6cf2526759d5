#include "MeasureTrunk.h"

#include "CBodyTrack.h"
#include "Directions.h"

namespace gw {

namespace {

// A larger difference is caused by a rest pose that is not a standing pose, not by proportions.
constexpr double kMostRestDegrees = 30.0;

// Returns a direction in the trunk's own axes: y along its line, x along the hips.
Vec3 InTrunk(const TrunkLine& trunk, const Vec3& direction)
{
    return Turned(direction, TurnUpright(trunk.chord, Vec3Normalized(trunk.across)));
}

// Returns the direction of the result's line relative to the source's trunk when both are at rest.
Vec3 RestChord(const CBodyTrack& source, const CBodyTrack& result)
{
    const Vec3 chord = Vec3Normalized(InTrunk(source.RestTrunk(), result.RestTrunk().chord));
    return chord.y > 0.0f && AngleBetween(chord, kVec3UnitY) <= kMostRestDegrees ? chord : kVec3UnitY;
}

bool HasTrunk(const CBodyTrack& track)
{
    return !track.Legs().empty() && !track.Neck().empty();
}

} // namespace

std::vector<float> TrunkErrors(const CBodyTrack& source, const CBodyTrack& result)
{
    std::vector<float> errors;
    if (!HasTrunk(source) || !HasTrunk(result))
        return errors;
    const Vec3 rest = RestChord(source, result);
    for (size_t f = 0; f < source.FrameCount(); ++f)
    {
        const Vec3 chord = InTrunk(source.Trunk(f), result.Trunk(f).chord);
        errors.push_back(static_cast<float>(AngleBetween(rest, chord)));
    }
    return errors;
}

} // namespace gw
