#pragma once

#include "CNode.h"
#include "MeasureConversion.h"

#include <functional>
#include <string>
#include <vector>

namespace gw {

/// A body that tests build and move: hips at 900 mm, legs of 400 + 400 mm straight down, feet that point
/// along +z, a spine, a neck and arms that stretch sideways. In its rest pose the soles lie on y = 0. Its
/// bones bear the target skeleton's names, so that two figures pair by name.
class CMadeFigure
{
public:
    /// `unit` is the number of units in a millimetre: 0.001 for a figure in metres.
    explicit CMadeFigure(double unit = 1.0);

    CNode& Bone(const std::string& name) const;
    /// Hangs a new joint under a bone, at an offset in mm.
    CNode& AddBone(const std::string& name, const std::string& parent, const Vec3& offset);

    // Poses of the frame that is being recorded; each frame starts from the rest pose.
    /// Turns a bone about an axis by degrees.
    void Turn(const std::string& name, const Vec3& axis, double degrees);
    /// Moves a bone by mm in its parent's space.
    void Move(const std::string& name, const Vec3& offset);

    /// Makes tracks of `frameCount` keys: the pose function is called for each frame on the figure at rest.
    MotionClip Record(int frameCount, const std::function<void(CMadeFigure&, int frame)>& pose,
                      float frequency = 1.0f / 30.0f);
    /// The figure with these joints gone: "LToe" and "RToe" make feet without toes.
    void Remove(const std::string& name);

private:
    std::vector<CNode*> Bones() const;

    Ref<CNode> m_spkRoot;
    float m_fUnit;
};

/// What was put in is measured within 1 %; a figure of 0 within a thousandth.
void ExpectMeasured(double figure, double putIn);

/// All bones that both figures have, paired by name.
std::vector<BonePair> PairByName(const CMadeFigure& source, const CMadeFigure& result);

} // namespace gw
