#pragma once

#include "CBVHExam.h"
#include "CFindings.h"
#include "MotionFacts.h"

#include <memory>
#include <optional>
#include <string>

namespace gw {

class CFailureRecord;
class CMotionFile;

/// The examination of one file: its faults, and facts about its motion.
class CFileExam
{
public:
    /// Examines a BVH file: its text line by line, and its poses if a reader accepts it.
    void ExamineBVH(const std::string& path);
    /// Adds the failures and warnings of the reader of any other file.
    void TakeRecord(const std::string& path, const CFailureRecord& record);
    /// Examines the poses of a motion that was read from another file.
    void ExaminePoses(const CMotionFile& motion);

    const CFindings& Findings() const { return m_kFindings; }
    /// Returns nothing if no motion was read.
    const std::optional<MotionFacts>& Facts() const { return facts_; }

    /// Writes a BVH file with all repairable faults fixed. Works only once, because the text is released
    /// afterwards. Returns false if it cannot be written.
    bool WriteMended(const std::string& path);
    /// Same for text that goes elsewhere, in pieces.
    bool WriteMended(const CTextSink& write);

private:
    CFindings m_kFindings;
    std::optional<MotionFacts> facts_;
    std::unique_ptr<CBVHExam> m_spText; // for a repaired copy
};

} // namespace gw
