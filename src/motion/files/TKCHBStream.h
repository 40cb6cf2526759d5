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

/// Binary character animation files: the same records as in a CHA file, field by field. Read only. Every
/// motion has the same fixed frequency, whatever rate the file stores.
class TKCHBStream : public CMotionFile
{
public:
    /// Fills motionRoot. Returns false if the file cannot be opened or has no root segment; throws ERROBJ if
    /// it is truncated or damaged. The reason is in Record() in both cases.
    bool Load(const std::string& path) override;
    /// Writing is not supported: returns false and touches no file.
    virtual bool WriteFile(const std::string& path);
    /// Gives a node the bone mesh of its segment.
    virtual void AddBoneShape(const TKCHFile& file, const TKCHSegment& segment, CNode& node);

protected:
    bool IsSourceWhole() const override { return m_kFile.IsWhole(); }

private:
    // The calling source line, as a default argument. Not every supported compiler has std::source_location.
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
    /// Returns the text of an exception about an unexpected keyword or frame number.
    std::string LineText() const;

    CMappedFile m_kFile;
    size_t m_uiPosition = 0;
    int m_iLine = 0; // keywords read; each starts a line in the text version of the format
    std::vector<TKCHSegment> m_kWork;
};

} // namespace gw
