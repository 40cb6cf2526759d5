#pragma once

#include "CMotionFile.h"

#include <string>

namespace gw {

struct TKHTRFile;
struct TKHTRSegment;

/// Hierarchical translation-rotation files, the only format that Save writes and the only one with a rest
/// pose besides the motion. A row's rotation is applied before the base pose's; its translation is added to
/// the base translation. Angles are degrees, lengths stay in file units.
class TKHTRStream : public CMotionFile
{
public:
    TKHTRStream() = default;
    /// Shares the other's trees, for writing.
    explicit TKHTRStream(const CMotionFile& trees) : CMotionFile(trees) {}

    /// Fills restRoot and motionRoot. Returns false, with the reason in Record(), if the file is not valid
    /// HTR.
    bool Load(const std::string& path) override;
    /// Writes restRoot as base pose and motionRoot as rows, with frameScale times as many frames at the same
    /// rate. Returns false if a tree is missing or the file cannot be written. Leaves the motion switched on,
    /// at time 0.
    bool Save(const std::string& path, float frameScale) override;
    bool SaveText(const CByteSink& sink, float frameScale, std::string_view head) override;
    /// Gives a node the bone mesh of its segment.
    virtual void AddBoneShape(const TKHTRFile& file, const TKHTRSegment& segment, CNode& node);

private:
    bool BuildRestTree(const TKHTRFile& file);
    bool BuildAnimatedTree(const TKHTRFile& file);
    void FillRestNode(const TKHTRFile& file, const TKHTRSegment& segment, CNode& node);
    void FillAnimatedNode(const TKHTRFile& file, TKHTRSegment& segment, CNode& node);

    bool FillHeader(TKHTRFile& file, float frameScale);
    template <class T>
    bool SaveTo(const T& destination, float frameScale, std::string_view head);
};

} // namespace gw
