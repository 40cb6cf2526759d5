#pragma once

#include "CMotionFile.h"

#include <string>

namespace gw {

struct TKCHFile;
struct TKCHSegment;

/// Character animation files as text: a local matrix and position for every segment and frame. Read only.
/// Lengths stay in file units.
class TKCHAStream : public CMotionFile
{
public:
    /// Fills motionRoot. Returns false, with the reason in Record(), if the file is not valid CHA.
    bool Load(const std::string& path) override;
    /// Writing is not supported: returns false and touches no file.
    virtual bool WriteFile(const std::string& path);
    /// Gives a node the bone mesh of its segment.
    virtual void AddBoneShape(const TKCHFile& file, const TKCHSegment& segment, CNode& node);

private:
    bool BuildAnimatedTree(TKCHFile& file);
};

} // namespace gw
