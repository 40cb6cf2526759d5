#pragma once

#include "CBodyMap.h"
#include "CMadeFigure.h"
#include "CMotionFile.h"
#include "Mat3.h"

#include <random>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// A human skeleton made from a recipe, with meaningless names. Its unit is meters or centimeters, and left
/// and right differ a little, as in measured skeletons.
///
/// A recipe is a list of words separated by blanks:
/// plain                                nothing else
/// spine1 ... spine10, neck0 ... neck3  numbers of joints; default: three and one
/// noclavicle, notoes, nofeet           missing joints; a foot without a toe has a bone to its tip
/// bare                                 end joints have no bones
/// fingers, toes5, face                 joints beyond hands, feet and head
/// handend, headend                     one such joint
/// helpers                              a joint before each limb that carries its offset, and one of length 0
/// hipjoints                            a short joint between pelvis and thigh, longer on the left
/// twist, twistleaf                     joints inside the long bones, or beside them
/// root, prop, sword, tail              a joint above the hip at the floor; additional objects
/// rightfirst, torsofirst               the order of children; default: the left leg comes first
/// zup, turned                          up is z; the body looks along -x
/// apose, down                          the arms at rest; default: stretched sideways
/// nopose                               at rest all bones are along x; only frames show the stance
/// walk                                 frames in which it walks
/// rest                                 the frames show the rest pose
/// child, longarms, metres              proportions and unit
/// exact                                straight from hip to head, and left as right
class CMadeSkeleton
{
public:
    CMadeSkeleton(std::string_view recipe, unsigned seed);

    CNode& Root() const { return m_kFigure.Root(); }
    const CMotionFile& Motion() const { return m_kMotion; }
    /// Returns the joints by what they were made as.
    const CBodyMap& Body() const { return m_kBody; }

private:
    struct Joint
    {
        CNode* node;
        size_t parent;              // its own index for the root
        Vec3 place;                 // in a stance with y up and the body facing z
        Vec3 tip = kVec3Zero;       // of an end joint, relative to its place
        double bend = 0.0;          // about the stance's x axis while walking, in degrees
        double swing = 0.0;         // amplitude that is added to it
        Mat3 frame = kMat3Identity; // axes in the stance
    };

    bool Has(std::string_view word) const;
    int Number(std::string_view word, int otherwise) const;
    float Jitter();
    size_t Add(size_t parent, const Vec3& place, CNode** role = nullptr);
    size_t AddBone(size_t from, const Vec3& to, CNode** role);
    size_t AddHelpers(size_t parent, const Vec3& place);
    void AddBody();
    void AddTrunk(size_t hip);
    void AddLeg(size_t hip, EBodySide side);
    void AddFoot(size_t shin, const Vec3& ankle, EBodySide side);
    void AddArm(size_t chest, EBodySide side);
    void AddFingers(size_t hand, const Vec3& along);
    void AddHead(size_t chest);
    void TurnFrames();
    void Pose(int frame);

    std::string m_kRecipe;
    std::mt19937 m_kRandom;
    Mat3 m_kAxes; // from the stance's axes to the figure's
    CMadeFigure m_kFigure;
    std::vector<Joint> m_kJoints; // parents before children
    CBodyMap m_kBody;
    CMotionFile m_kMotion;
};

/// Returns recipes for the usual shapes of skeletons.
std::vector<std::string> SkeletonRecipes();

} // namespace gw
