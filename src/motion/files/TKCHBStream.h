#pragma once

#include "CMappedFile.h"
#include "CMotionFile.h"
#include "TKCHFile.h"

#include <cstddef>
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

protected:
    bool IsSourceWhole() const override { return m_kFile.IsWhole(); }

private:
    // The line of the source that asks, as a default argument tells it. Not every compiler that builds this
    // has the library's class for it.
    using Line = int;

    bool ReadFile(TKCHFile& file);
    void ReadHeader(TKCHFile& file);
    void ReadLengths(TKCHFile& file);
    void ReadHierarchy(TKCHFile& file);
    void ReadMotion(TKCHFile& file);
    void ReadFrame(int number);
    void TakeFrames(TKCHFile& file);
    bool BuildAnimatedTree(TKCHFile& file);

    void ReadKeyword(std::string_view keyword, Line line = __builtin_LINE());
    int ReadInt(Line line = __builtin_LINE());
    void ReadFloats(std::span<float> values, Line line = __builtin_LINE());
    std::string_view ReadName(Line line = __builtin_LINE());
    std::string_view TakeBytes(size_t count, Line line);
    [[noreturn]] void Raise(EFailure reason, const std::string& name, Line line,
                            const std::string& what = {});
    /// What an exception tells of a keyword or a frame that is another than it must be.
    std::string LineText() const;

    CMappedFile m_kFile;
    size_t m_uiPosition = 0;
    int m_iLine = 0; // keywords read: each begins a line in the text twin of the format
    std::vector<TKCHSegment> m_kWork;
};

} // namespace gw
