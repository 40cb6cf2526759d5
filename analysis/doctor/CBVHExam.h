#pragma once

#include "BVHOutline.h"
#include "CByteSink.h"
#include "CFailureRecord.h"
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

/// The text of a BVH file under examination: its faults, whether or not a reader accepts it, and its repaired
/// form.
class CBVHExam
{
public:
    explicit CBVHExam(CFindings& findings) : findings_(findings) {}

    /// Reads the whole text. Returns None on success, otherwise why it cannot be examined.
    EFailure Examine(const std::string& path);
    /// Releases the memory of the text, which is read again when needed.
    void Forget() { m_kFile.Forget(m_kFile.Text().size()); }
    /// Returns whether the file still has all the bytes that were examined.
    bool IsWhole() const { return m_kFile.IsWhole(); }
    /// Returns the structure of the text before its rows.
    const BVHOutline& Outline() const { return m_kOutline; }
    /// Writes the text with all repairable faults fixed. If the file cannot be written, returns false and
    /// keeps the old one.
    bool WriteMended(const std::string& path);
    /// Same for text that goes elsewhere, in pieces.
    bool WriteMended(const CTextSink& write);

private:
    void ReadRows(CLineCursor& lines);

    CMappedFile m_kFile;
    std::string m_kClean; // the text, if bytes of the file had to be removed
    std::string_view m_kText;
    CFindings& findings_;
    CTextEdits m_kEdits;
    BVHOutline m_kOutline;
    RowPlan m_kPlan;
    std::vector<MendedCell> m_kCells;
    bool m_bRows = false; // rows were found and understood
};

} // namespace gw
