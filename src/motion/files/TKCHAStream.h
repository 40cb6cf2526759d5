#pragma once

#include "CMotionFile.h"

#include <string>

namespace gw {

struct TKCHFile;
struct TKCHSegment;

/// Character animation files as text: for every segment and frame a matrix and a position, both local. Read
/// only. Lengths stay in units of the file.
class TKCHAStream : public CMotionFile
{
public:
    /// Fills motionRoot. False, with the reason in Record(), for what is no CHA file.
    bool Load(const std::string& path) override;
    /// The format is not written: false, and no file is touched.
    virtual bool WriteFile(const std::string& path);
    /// Gives a node the bone mesh of its segment.
    virtual void AddBoneShape(const TKCHFile& file, const TKCHSegment& segment, CNode& node);

private:
    bool BuildAnimatedTree(TKCHFile& file);
};

} // namespace gw
