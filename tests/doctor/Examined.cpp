#include "Examined.h"

#include "CMotionFile.h"
#include "FindingWords.h"

#include <gtest/gtest.h>

namespace gw {

CExamined::CExamined(std::string_view text, const std::string& name) : m_kPath(m_kFolder.Path(name))
{
    WriteBytes(m_kPath, text);
    m_kExam.ExamineBVH(m_kPath);
}

std::string CExamined::Found() const
{
    std::string found;
    for (const Finding& finding : m_kExam.Findings().Sorted())
    {
        found += found.empty() ? "" : ", ";
        found += std::to_string(finding.where) + ' ' + std::string(FindingCode(finding));
    }
    return found;
}

bool CExamined::Loads() const
{
    CMotionFile motion;
    return motion.Load(m_kPath);
}

std::string CExamined::Mended()
{
    const std::string path = m_kFolder.Path("mended.bvh");
    if (!m_kExam.WriteMended(path))
        ADD_FAILURE() << "no mended copy";
    return ReadBytes(path);
}

} // namespace gw
