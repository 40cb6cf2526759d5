#pragma once

#include "BVHOutline.h"
#include "CFailure.h"
#include "CFindings.h"
#include "CMappedFile.h"
#include "CRowCheck.h"
#include "CRowTable.h"
#include "CTextEdits.h"

#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CLineCursor;

/// The text of a BVH file under examination: what is wrong with it as it stands, whether or not a reader
/// takes it, and how it would stand mended.
class CBVHExam
{
public:
    explicit CBVHExam(CFindings& findings) : findings_(findings) {}

    /// Reads the whole text. None on success, else why there is none to examine.
    EFailure Examine(const std::string& path);
    /// Gives back the memory of the text, which is read again where it is needed.
    void Forget() { m_kFile.Forget(m_kFile.Text().size()); }
    /// Whether the file still has all the bytes that were examined.
    bool IsWhole() const { return m_kFile.IsWhole(); }
    /// What the text says before its rows.
    const BVHOutline& Outline() const { return m_kOutline; }
    /// Writes the text with all mendable faults gone. False when the file cannot be written; the old one
    /// stands then.
    bool WriteMended(const std::string& path);

private:
    void ReadRows(CLineCursor& lines);

    CMappedFile m_kFile;
    std::string m_kClean; // the text, where bytes of the file had to go
    std::string_view m_kText;
    CFindings& findings_;
    CTextEdits m_kEdits;
    BVHOutline m_kOutline;
    RowPlan m_kPlan;
    std::vector<MendedCell> m_kCells;
    bool m_bRows = false; // there are rows that were understood
};

} // namespace gw
