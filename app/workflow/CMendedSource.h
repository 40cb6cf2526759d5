#pragma once

#include "CFindings.h"
#include "CPrivateFile.h"

#include <string>

namespace gw {

class CFileExam;

/// A source that is read repaired: a temporary copy, as `doctor --fix` writes it, which is deleted with the
/// object.
class CMendedSource
{
public:
    /// Examines a .bvh file and, if it has faults that can be repaired, writes a copy without them. Other
    /// files are left alone. Returns false if the copy cannot be written: see TakeSystemError.
    bool Mend(const std::string& path);

    bool IsMended() const { return !m_kCopy.Path().empty(); }
    /// Returns the copy's path; empty if the source itself should be read.
    const std::string& Path() const { return m_kCopy.Path(); }
    /// Returns what was repaired: "line 350: an empty line between MOTION and the rows".
    std::string Words() const;

private:
    bool WriteCopy(CFileExam& exam);

    CPrivateFile m_kCopy;
    std::string m_kPath;
    CFindings m_kFindings;
};

} // namespace gw
