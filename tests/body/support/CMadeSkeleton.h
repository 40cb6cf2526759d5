#pragma once

#include "BodyJoints.h"
#include "CMadeText.h"
#include "CMotionFile.h"
#include "Mat3.h"

#include <map>
#include <memory>
#include <random>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// A human skeleton made from a recipe, with meaningless names, written as a motion file and loaded. Its unit
/// is meters or centimeters, and left and right differ a little, as in measured skeletons.
///
/// A recipe is a list of words separated by blanks:
/// spine1 ... spine10, neck0 ... neck3  numbers of joints; default: three and one
/// noclavicle, notoes, nofeet           missing joints; a foot without a toe has a bone to its tip
/// bare                                 end joints have no bones
/// fingers, toes5, face, headend        joints beyond hands, feet and head
/// helpers                              a joint before each limb that carries its offset, and one of length 0
/// hipjoints                            a short joint between pelvis and thigh
/// twist, twistleaf                     joints inside the long bones, or beside them
/// root, prop, sword, tail              a joint above the hip at the floor; additional objects
/// rightfirst, torsofirst               the order of children; default: the left leg comes first
/// zup, turned                          up is z; the body looks along -x
/// apose, down                          the arms at rest; default: stretched sideways
/// nopose                               at rest all bones are along x; only frames show the stance
/// walk                                 frames in which it walks
/// rest                                 the frames show the rest pose
/// child, longarms, metres              proportions and unit
class CMadeSkeleton
{
public:
    CMadeSkeleton(std::string_view recipe, unsigned seed);

    CNode& Root() const { return *m_kMotion.motionRoot; }
    const CMotionFile& Motion() const { return m_kMotion; }
    /// Returns the name at a place of the body; empty if the skeleton has none.
    std::string NameAt(BodyPlace place) const;

private:
    struct Joint
    {
        std::string name;
        Vec3 place; // in a stance with y up and the body facing z
        Joint* parent = nullptr;
        std::vector<std::unique_ptr<Joint>> children;
        Vec3 tip = kVec3Zero;   // of an end joint, relative to its place
        Vec3 swing = kVec3Zero; // amplitude of rotations about the axes while walking, in degrees
        Mat3 world = kMat3Identity;
    };

    bool Has(std::string_view word) const;
    int Number(std::string_view word, int otherwise) const;
    double Jitter(double value);
    Joint& Add(Joint* parent, const Vec3& place);
    Joint& AddAt(Joint& parent, const Vec3& place, BodyPlace role);
    Joint& AddBone(Joint& from, const Vec3& to, BodyPlace role, bool twists);
    Joint& AddHelpers(Joint& parent, const Vec3& place);
    void AddBody();
    void AddTrunk(Joint& hip);
    void AddLeg(Joint& hip, EBodySide side);
    void AddFoot(Joint& ankle, EBodySide side, float x);
    void AddArm(Joint& chest, EBodySide side);
    void AddFingers(Joint& hand, const Vec3& along);
    void AddHead(Joint& chest);
    void TurnFrames(Joint& joint);
    Vec3 World(const Vec3& place) const;
    Vec3 OffsetOf(const Joint& joint) const;
    void AppendJoints(std::vector<TextJoint>& joints, const Joint& joint, int parent) const;
    void AppendRotations(std::vector<Vec3>& degrees, const Joint& joint, const Mat3& parentTurn,
                         double phase) const;
    std::string Text() const;

    std::string m_kRecipe;
    std::mt19937 m_kRandom;
    std::unique_ptr<Joint> m_spkRoot;
    std::map<size_t, std::string> m_kRoles; // by IndexOf
    CMotionFile m_kMotion;
};

/// Returns recipes for the usual shapes of skeletons.
std::vector<std::string> SkeletonRecipes();

} // namespace gw
