#pragma once

#include "CFileExam.h"
#include "TempFolder.h"

#include <string>
#include <string_view>

namespace gw {

/// A text that was examined as a BVH file.
class CExamined
{
public:
    explicit CExamined(std::string_view text, const std::string& name = "motion.bvh");

    const std::string& Path() const { return m_kPath; }
    CFileExam& Exam() { return m_kExam; }
    /// Returns all findings, as "12 blank-in-name, 40 spike": line and code.
    std::string Found() const;
    /// Returns whether the reader accepts the file.
    bool Loads() const;
    /// Returns the text of a repaired copy.
    std::string Mended();

private:
    CTempFolder m_kFolder;
    std::string m_kPath;
    CFileExam m_kExam;
};

} // namespace gw
