#pragma once

#include "CFailure.h"
#include "CNode.h"
#include "Mat3.h"
#include "Vec3.h"

#include <cstddef>
#include <functional>
#include <map>
#include <string>
#include <vector>

namespace gw {

class CFaithfulPose;
class CKeyframeControl;
class CPoseMatcher;

/// Per-bone tuning of the target skeleton, from the share file.
struct BoneShares
{
    float m_fShare1 = 0.0f; ///< weight in the blend between the two decompositions
    float m_fShare2 = 0.0f; ///< weight in the sine curve of the first rotation
    float m_fType = 0.0f;   ///< decomposition: 0, 1 or any other, truncated
};

/// Turns the motion of a source skeleton into keyframes on the target skeleton. Told what to do by five
/// tables keyed by target node; the nodes are looked at and not kept alive, so the trees must live as long as
/// the tables are used. Row vectors; world position means the fourth row of a world matrix; lengths are in
/// the skeletons' own units.
class CRetargeter
{
public:
    CRetargeter();
    ~CRetargeter();
    CRetargeter(const CRetargeter&) = delete;
    CRetargeter& operator=(const CRetargeter&) = delete;

    /// Stores the two roots and empties all tables but the shares.
    void SetScenes(CNode* sourceRoot, CNode* targetRoot);
    /// Empties all tables but the shares.
    void ClearMaps();
    /// Reads the share file of the target skeleton. False when it cannot be opened; where it is there all the
    /// same, the record tells why.
    bool LoadShares(const std::string& path);

    // Each replaces the entry of a key that is there and answers true.
    bool SetSourceOf(CNode* target, CNode* source);
    bool SetOffsetAngles(CNode* target, const Vec3& degrees);
    bool SetOffsetMatrix(CNode* target, const Mat3& matrix);
    bool SetFixed(CNode* target, bool fixed);
    bool SetShares(CNode* target, const BoneShares& shares);

    /// Whether a bone that takes the whole of a rotation takes it as it is, also at whole quarter turns,
    /// where the decomposition of its share gives another one back. Off by the rules; the tables do not
    /// change it.
    void SetPlainTurns(bool plain) { m_bPlainTurns = plain; }
    bool HasPlainTurns() const { return m_bPlainTurns; }

    // Lookups take null keys and absent ones, and insert nothing.
    CNode* SourceOf(const CNode* node) const;
    const Vec3& OffsetAngles(const CNode* node) const;
    const Mat3& OffsetMatrix(const CNode* node) const;
    bool IsFixed(const CNode* node, bool& fixed) const;
    bool Shares(const CNode* node, const BoneShares*& shares) const;

    /// The source's size as a factor for the target, and how far the feet rise over the ground: leg plus
    /// pelvis heights compared, bent by `weight`. Both trees stand in rest pose. Outputs are left alone where
    /// LFoot, RFoot or LThigh has no source.
    void MeasureBody(float& scale, float& footRise, float weight) const;

    /// Poses the target frame by frame after the source and leaves a new track on every target node. `begin`,
    /// `last`, `phase` and `frequency` go into the tracks; frames run from 0 through `last`. With
    /// `resetOrigin` the first frame stands at `rootPosition`; with `useLegs` the limb solver plants the
    /// feet. Always true; see Record().
    bool Retarget(float begin, float last, float phase, float frequency, const Vec3& rootPosition,
                  bool resetOrigin, bool useLegs);

    /// Whether runs from now on let hips, knees and feet keep to the source instead (CFaithfulPose), as far
    /// as its legs are mapped from thigh to foot. `useLegs` then tells whether feet are held where they
    /// stand.
    void SetFaithful(bool faithful) { m_bFaithful = faithful; }

    /// What a run calls now and then, with the frames done and their number.
    void SetProgress(std::function<void(size_t, size_t)> progress) { progress_ = std::move(progress); }

    /// What the last run was not happy with.
    const CFailureRecord& Record() const { return m_kRecord; }

private:
    /// What a run was asked for.
    struct Run
    {
        float frequency;
        const Vec3& rootPosition;
        bool resetOrigin;
        bool useLegs;
    };

    float MeasuredScale();
    void PoseFrames(CPoseMatcher& matcher, const std::vector<CKeyframeControl*>& tracks, const Run& run,
                    CFaithfulPose* keeper);
    void MatchFrames(CPoseMatcher& matcher, const std::vector<CKeyframeControl*>& tracks, const Run& run,
                     CFaithfulPose* keeper);
    void ShowProgress(size_t done, size_t total) const;

    std::map<const CNode*, BoneShares> m_kBoneShares;
    std::map<const CNode*, CNode*> m_kSourceOf;
    std::map<const CNode*, Vec3> m_kOffsetAngles;
    std::map<const CNode*, bool> m_kFixedBones;
    std::map<const CNode*, Mat3> m_kOffsetMatrices;
    CNode* m_pkSourceRoot = nullptr;
    CNode* m_pkTargetRoot = nullptr;
    bool m_bFaithful = false;
    bool m_bPlainTurns = false;
    CFailureRecord m_kRecord;
    std::function<void(size_t, size_t)> progress_;
};

} // namespace gw
