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

/// The examination of one file: what is wrong with it, and what there is to know of its motion.
class CFileExam
{
public:
    /// Examines a BVH file: its text line by line, and its poses where a reader takes it.
    void ExamineBVH(const std::string& path);
    /// Takes over what the reader of any other file said.
    void TakeRecord(const std::string& path, const CFailureRecord& record);
    /// Looks at the poses of a motion that was read from another file.
    void ExaminePoses(const CMotionFile& motion);

    const CFindings& Findings() const { return m_kFindings; }
    /// Nothing where no motion was read.
    const std::optional<MotionFacts>& Facts() const { return facts_; }

    /// Writes a BVH file again with all mendable faults gone, once: its text is given back after that. False
    /// when it cannot be written.
    bool WriteMended(const std::string& path);

private:
    CFindings m_kFindings;
    std::optional<MotionFacts> facts_;
    std::unique_ptr<CBVHExam> m_spText; // for a mended copy
};

} // namespace gw
