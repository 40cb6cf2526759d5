#pragma once

#include "CMotionFile.h"
#include "COrrinStream.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace gw {

class CKeyframeControl;

/// A node as a walk finds it, with the node above it or null.
struct FoundNode
{
    CNode* node;
    CNode* parent;
    size_t depth;
};

/// Any file that the program can read, a motion or a container, as one thing: roots, nodes and a clock.
class CSceneFile
{
public:
    /// Reads a file by its extension, else by its beginning. False, with the reason in Failure(), when
    /// nothing of it can be used. A damaged container is true as far as it could be read: see IsDamaged.
    bool Load(const std::string& path);

    /// The same for those who need all of it. Says what is wrong.
    bool LoadWhole(const std::string& path);

    bool IsContainer() const { return m_bContainer; }
    bool IsDamaged() const { return m_bContainer && Record().Failure(); }
    const CFailureRecord& Record() const { return m_bContainer ? m_kScene.Record() : m_kMotion.Record(); }
    const CFailure& Failure() const { return Record().Failure(); }

    const CMotionFile& Motion() const { return m_kMotion; }
    COrrinStream& Scene() { return m_kScene; }

    /// All nodes that hang under the roots, depth first, each at the first of its places.
    std::vector<FoundNode> Nodes() const;
    /// The first track, whose clock counts for the whole file; null where there is none.
    const CKeyframeControl* FirstTrack();
    /// The time at which the first track reaches a frame.
    float TimeOf(int64_t frame);
    /// Brings one root after the other to a time.
    void Update(float time);
    /// The roots of a container, in their order, or the root of a motion.
    std::vector<CObject*> Roots() const;
    /// All objects that the roots hold, in save order.
    std::vector<CObject*> Objects();

private:
    bool m_bContainer = false;
    CMotionFile m_kMotion;
    COrrinStream m_kScene;
};

} // namespace gw
