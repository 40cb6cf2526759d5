#include "CBVHExam.h"

#include "CHierarchyCheck.h"
#include "CLineCursor.h"
#include "CMotionHeadCheck.h"
#include "CRowMender.h"
#include "CSafeFile.h"
#include "CheckJoints.h"
#include "CheckOffsets.h"
#include "CheckSpikes.h"
#include "CleanText.h"

namespace gw {

EFailure CBVHExam::Examine(const std::string& path)
{
    const EFailure failure = m_kFile.Open(path);
    if (failure != EFailure::None)
        return failure;
    m_kText = CleanText(m_kFile.Text(), m_kClean, findings_);
    CLineCursor lines(m_kText);
    const bool hasMotion = CHierarchyCheck(lines, findings_, m_kEdits).Read(m_kOutline);
    CheckJoints(m_kOutline, findings_);
    if (!hasMotion || m_kOutline.joints.empty())
        return EFailure::None;
    if (CMotionHeadCheck(lines, findings_, m_kEdits).Read(m_kOutline))
        ReadRows(lines);
    return EFailure::None;
}

void CBVHExam::ReadRows(CLineCursor& lines)
{
    CRowCheck check(m_kOutline, findings_);
    check.Read(lines);
    m_bRows = true;
    m_kPlan = check.Plan();
    m_kPlan.subtrahends = CheckOffsets(m_kOutline, check.Table(), findings_);
    CheckSpikes(m_kOutline, check.Table(), findings_);
    m_kCells = check.Table().TakeMended();
    if (m_kPlan.correctsCount)
        m_kEdits.Replace(m_kOutline.framesBegin, m_kOutline.framesLength, std::to_string(m_kPlan.rowCount));
}

bool CBVHExam::WriteMended(const std::string& path)
{
    CSafeFile file;
    return file.Open(path) && WriteMended([&](std::string_view text) { return file.Write(text); }) &&
           file.Commit();
}

bool CBVHExam::WriteMended(const CTextSink& write)
{
    const size_t rowsBegin = m_bRows ? m_kOutline.rowsBegin : m_kText.size();
    if (!m_kEdits.Write(m_kText.substr(0, rowsBegin), write))
        return false;
    if (m_bRows && !CRowMender(m_kOutline, m_kPlan, m_kCells).Write(m_kText, write))
        return false;
    return m_kFile.IsWhole();
}

} // namespace gw
