#pragma once

#include "CMotionFile.h"
#include "COrrinStream.h"
#include "CSourceFile.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace gw {

class CKeyframeControl;
struct ShellOptions;

/// A node found by a tree walk, and its parent, or null for a root.
struct FoundNode
{
    CNode* node;
    CNode* parent;
    size_t depth;
};

/// Any supported file, motion or container, as roots, nodes and a clock.
class CSceneFile
{
public:
    /// Reads a file by its extension, or by its first bytes if the extension is unknown. Returns false, with
    /// the reason in Failure(), if nothing in it is usable. Returns true for a damaged container, which is
    /// read as far as possible: see IsDamaged.
    bool Load(const std::string& path);

    /// Selects what Load reads, as CFileConversion::SelectSource.
    void SelectSource(const std::string& clip, float rate);
    /// Shows the motion inside a Kinetra file, if this is one. If it cannot be read, prints a warning.
    void ShowInside(const ShellOptions& options, const std::string& path);
    /// Returns whether the roots and nodes are those of a container.
    bool IsScene() const { return m_bContainer && !m_bInside; }

    /// Prints why Load failed.
    void SayFailure(const std::string& path) const;

    /// Same for commands that need the whole file. Returns false, after printing what is wrong, for a damaged
    /// file too.
    bool LoadWhole(const std::string& path);

    bool IsContainer() const { return m_bContainer; }
    /// Returns whether SelectSource has replaced the file's rate.
    bool HasGivenRate() const { return m_fRate > 0.0f; }
    bool IsDamaged() const { return m_bContainer && Record().Failure(); }
    const CFailureRecord& Record() const { return m_bContainer ? m_kScene.Record() : m_kMotion.Record(); }
    const Finding& Failure() const { return Record().Failure(); }

    /// Returns the file that was read: the source, or a temporary copy.
    const std::string& ReadPath() const { return m_kSource.Path(); }
    const CMotionFile& Motion() const { return m_kMotion; }
    COrrinStream& Scene() { return m_kScene; }

    /// Returns all nodes below the roots, depth first, each once at its first position.
    std::vector<FoundNode> Nodes() const;
    /// Returns the first track, whose clock applies to the whole file, or null.
    const CKeyframeControl* FirstTrack();
    /// Returns the time at which the first track reaches a frame.
    float TimeOf(int64_t frame);
    /// Updates all roots to a time, in order.
    void Update(float time);
    /// Returns the roots of a container, in order, or the root of a motion.
    std::vector<CObject*> Roots() const;
    /// Returns all objects that the roots hold, in save order.
    std::vector<CObject*> Objects();

private:
    bool LoadFile(const std::string& path);

    CSourceFile m_kSource;
    float m_fRate = 0.0f;
    bool m_bContainer = false;
    Notice m_kStreamFailure; ///< without words unless a source could not be copied
    bool m_bInside = false;  ///< the motion is that inside the container
    CMotionFile m_kMotion;
    COrrinStream m_kScene;
};

} // namespace gw
