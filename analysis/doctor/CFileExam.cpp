#include "CFileExam.h"

#include "CFailureRecord.h"
#include "CMappedFile.h"
#include "CMotionFile.h"
#include "CheckPoses.h"
#include "CleanText.h"

namespace gw {

namespace {

bool IsPointer(const std::string& path)
{
    CMappedFile file;
    return file.Open(path) == EFailure::None && IsLfsPointer(file.Text());
}

} // namespace

void CFileExam::ExamineBVH(const std::string& path)
{
    m_spText = std::make_unique<CBVHExam>(m_kFindings);
    if (const EFailure failure = m_spText->Examine(path); failure != EFailure::None)
        return m_kFindings.Add({failure});
    if (!m_spText->IsWhole())
        return m_kFindings.Add({EFailure::Changed});
    m_spText->Forget();
    CMotionFile motion;
    if (motion.Load(path))
        facts_ = CheckPoses(motion, &m_spText->Outline(), m_kFindings);
    // Faults found in the text are the ones that made the reader fail.
    else if (!m_kFindings.HasErrors())
        m_kFindings.Add(motion.Record().Failure());
}

bool CFileExam::WriteMended(const std::string& path)
{
    const std::unique_ptr<CBVHExam> text = std::move(m_spText);
    return text && text->WriteMended(path);
}

bool CFileExam::WriteMended(const CTextSink& write)
{
    const std::unique_ptr<CBVHExam> text = std::move(m_spText);
    return text && text->WriteMended(write);
}

void CFileExam::TakeRecord(const std::string& path, const CFailureRecord& record)
{
    if (record.Failure() && IsPointer(path))
        return m_kFindings.Add(EFailure::LfsPointer, 1);
    if (record.Failure())
        m_kFindings.Add(record.Failure());
    for (const Finding& warning : record.Warnings())
    {
        if (warning.reason != EFailure::RestPose) // reported with the facts
            m_kFindings.Add(warning);
    }
}

void CFileExam::ExaminePoses(const CMotionFile& motion)
{
    facts_ = CheckPoses(motion, nullptr, m_kFindings);
}

} // namespace gw
