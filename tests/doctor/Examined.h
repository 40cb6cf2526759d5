#pragma once

#include "CFileExam.h"
#include "TempFolder.h"

#include <string>
#include <string_view>

namespace gw {

/// A text that was examined as a BVH file of its own.
class CExamined
{
public:
    explicit CExamined(std::string_view text, const std::string& name = "motion.bvh");

    const std::string& Path() const { return m_kPath; }
    CFileExam& Exam() { return m_kExam; }
    /// All that was found, as "12 blank-in-name, 40 spike": line and code.
    std::string Found() const;
    /// Whether the reader takes the file.
    bool Loads() const;
    /// The text of a mended copy.
    std::string Mended();

private:
    CTempFolder m_kFolder;
    std::string m_kPath;
    CFileExam m_kExam;
};

} // namespace gw
