#pragma once

#include "CMotionFile.h"

#include <string>

namespace gw {

struct TKHTRFile;
struct TKHTRSegment;

/// Hierarchical translation-rotation files: the one format that is written by Save and that holds a rest pose
/// beside the motion. A row's rotation is a delta on the base pose that acts first, its translation an offset
/// from the base translation. Angles are degrees, lengths stay in units of the file.
class TKHTRStream : public CMotionFile
{
public:
    TKHTRStream() = default;
    /// Shares the other's trees, for writing.
    explicit TKHTRStream(const CMotionFile& trees) : CMotionFile(trees) {}

    /// Fills restRoot and motionRoot. False, with the reason in Record(), for what is no HTR file.
    bool Load(const std::string& path) override;
    /// Writes restRoot as base pose and motionRoot as rows, with frameScale times as many frames at the same
    /// rate. False where one is missing or the file cannot be written. Leaves the motion switched on, at time
    /// 0.
    bool Save(const std::string& path, float frameScale) override;
    bool SaveText(const CByteSink& sink, float frameScale) override;
    /// Gives a node the bone mesh of its segment.
    virtual void AddBoneShape(const TKHTRFile& file, const TKHTRSegment& segment, CNode& node);

private:
    bool BuildRestTree(const TKHTRFile& file);
    bool BuildAnimatedTree(const TKHTRFile& file);
    void FillRestNode(const TKHTRFile& file, const TKHTRSegment& segment, CNode& node);
    void FillAnimatedNode(const TKHTRFile& file, TKHTRSegment& segment, CNode& node);

    bool FillHeader(TKHTRFile& file, float frameScale);
    template <class T>
    bool SaveTo(const T& destination, float frameScale);
};

} // namespace gw
