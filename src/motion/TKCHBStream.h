#pragma once

#include "CMappedFile.h"
#include "CMotionFile.h"
#include "TKCHFile.h"

#include <cstddef>
#include <source_location>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// Character animation files in binary: the same records as in a CHA file, field after field. Read only.
/// Every motion has the same fixed frequency, whatever the rate in the file.
class TKCHBStream : public CMotionFile
{
public:
    /// Fills motionRoot. False for a file that cannot be opened and for one without a root segment; throws
    /// ERROBJ for one that is cut short or damaged. The reason is in Record() both times.
    bool Load(const std::string& path) override;
    /// The format is not written: false, and no file is touched.
    virtual bool WriteFile(const std::string& path);
    /// Gives a node the bone mesh of its segment.
    virtual void AddBoneShape(const TKCHFile& file, const TKCHSegment& segment, CNode& node);

private:
    using Location = std::source_location;

    bool ReadFile(TKCHFile& file);
    void ReadHeader(TKCHFile& file);
    void ReadLengths(TKCHFile& file);
    void ReadHierarchy(TKCHFile& file);
    void ReadMotion(TKCHFile& file);
    void ReadFrame(int number);
    void TakeFrames(TKCHFile& file);
    bool BuildAnimatedTree(TKCHFile& file);

    void ReadKeyword(std::string_view keyword, Location location = Location::current());
    int ReadInt(Location location = Location::current());
    void ReadFloats(std::span<float> values, Location location = Location::current());
    std::string_view ReadName(Location location = Location::current());
    std::string_view TakeBytes(size_t count, Location location);
    [[noreturn]] void Raise(EFailure reason, const std::string& name, Location location,
                            const std::string& what = {});
    /// What an exception tells of a keyword or a frame that is another than it must be.
    std::string LineText() const;

    CMappedFile m_kFile;
    size_t m_uiPosition = 0;
    int m_iLine = 0; // keywords read: each begins a line in the text twin of the format
    std::vector<TKCHSegment> m_kWork;
};

} // namespace gw
