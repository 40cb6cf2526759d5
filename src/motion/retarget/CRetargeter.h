#pragma once

#include "CFailureRecord.h"
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

/// Settings of a target bone from the share file.
struct BoneShares
{
    float m_fShare1 = 0.0f; ///< weight in the blend between the two decompositions
    float m_fShare2 = 0.0f; ///< weight in the sine curve of the first rotation
    float m_fType = 0.0f;   ///< decomposition: 0, 1, or 2 for all other values; truncated to an integer
};

/// Converts the motion of a source skeleton to keyframes on the target skeleton, as described by five tables
/// keyed by target node. Nodes are not kept alive, so the trees must outlive the tables. Row vectors; a world
/// position is the fourth row of a world matrix; lengths are in the skeletons' own units.
class CRetargeter
{
public:
    CRetargeter();
    ~CRetargeter();
    CRetargeter(const CRetargeter&) = delete;
    CRetargeter& operator=(const CRetargeter&) = delete;

    /// Stores the two roots and clears all tables except the shares.
    void SetScenes(CNode* sourceRoot, CNode* targetRoot);
    /// Clears all tables except the shares.
    void ClearMaps();
    /// Reads the share file of the target skeleton. Returns false if it cannot be opened; if it exists, the
    /// record contains the reason.
    bool LoadShares(const std::string& path);

    // Each sets the entry of a target bone, replacing an old one, and returns true.
    bool SetSourceOf(CNode* target, CNode* source);
    bool SetOffsetAngles(CNode* target, const Vec3& degrees);
    bool SetOffsetMatrix(CNode* target, const Mat3& matrix);
    bool SetFixed(CNode* target, bool fixed);
    bool SetShares(CNode* target, const BoneShares& shares);

    /// If set, a bone with the whole share of a rotation takes it unchanged even at exact quarter turns,
    /// where its decomposition would return a different rotation. Off by default; the tables do not change
    /// it.
    void SetPlainTurns(bool plain) { m_bPlainTurns = plain; }
    bool HasPlainTurns() const { return m_bPlainTurns; }

    // Lookups accept null and unknown nodes, and insert nothing.
    CNode* SourceOf(const CNode* node) const;
    const Vec3& OffsetAngles(const CNode* node) const;
    const Mat3& OffsetMatrix(const CNode* node) const;
    bool IsFixed(const CNode* node, bool& fixed) const;
    bool Shares(const CNode* node, const BoneShares*& shares) const;

    /// Computes the source's size as a factor for the target and how far the feet rise above the ground, from
    /// leg and pelvis heights, adjusted by `weight`. Both trees must be in rest pose. The outputs are not
    /// changed if LFoot, RFoot or LThigh has no source.
    void MeasureBody(float& scale, float& footRise, float weight) const;

    /// Poses the target like the source, frame by frame, and leaves a new track on every target node.
    /// `begin`, `last`, `phase` and `frequency` are stored in the tracks; frames run from 0 through `last`.
    /// With `resetOrigin`, the first frame is at `rootPosition`. With `useLegs`, the limb solver plants the
    /// feet. Always returns true; see Record().
    bool Retarget(float begin, float last, float phase, float frequency, const Vec3& rootPosition,
                  bool resetOrigin, bool useLegs);

    /// If set, later runs keep trunk, hips, knees and feet close to the source (CFaithfulPose), for legs that
    /// are mapped from thigh to foot. `useLegs` then decides whether planted feet are held in place.
    void SetFaithful(bool faithful) { m_bFaithful = faithful; }
    /// Whether such runs also keep the gaps of hands to what they touch; on by default.
    void SetHoldHands(bool hold) { m_bHoldHands = hold; }

    /// Sets a callback that a run calls periodically with the number of frames done and the total.
    void SetProgress(std::function<void(size_t, size_t)> progress) { progress_ = std::move(progress); }

    /// Failures and warnings of the last run.
    const CFailureRecord& Record() const { return m_kRecord; }

private:
    /// Arguments of the current run.
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
    bool m_bHoldHands = true;
    bool m_bPlainTurns = false;
    CFailureRecord m_kRecord;
    std::function<void(size_t, size_t)> progress_;
};

} // namespace gw
