#include "CPrivateFile.h"

#include "LiveNames.h"
#include "Paths.h"
#include "PrivateNames.h"
#include "SystemError.h"

#include <utility>

namespace gw {

namespace {

constexpr unsigned kModeOfOwner = 0600;

} // namespace

CPrivateFile::CPrivateFile(const std::string& besidePath, std::string_view extension)
{
    Create(FolderOf(besidePath), extension, kModeOfOwner);
}

CPrivateFile::~CPrivateFile()
{
    Remove();
}

bool CPrivateFile::Create(const std::string& folder, std::string_view extension, unsigned mode)
{
    constexpr int kAttempts = 16; // even a second attempt is extremely rare
    Remove();
    SweepOnce(folder);
    for (int i = 0; i < kAttempts; ++i)
    {
        m_kPath = PrivateName(folder, extension);
        // before the file exists, because a signal could arrive in between
        m_iLiveName = AddLiveName(m_kPath);
        m_iFile = OpenFile(m_kPath, EOpen::New, mode);
        const bool isTaken = m_iFile < 0 && IsNameTaken(LastSystemError());
        if (m_iFile < 0)
            KeepSystemError();
        if (m_iFile >= 0 && LockNewFile(m_iFile))
            return true;
        const bool isSwept = m_iFile >= 0;
        Release();
        if (!isTaken && !isSwept)
            break;
    }
    return false;
}

bool CPrivateFile::CreateTemporary(std::string_view extension)
{
    const std::string folder = TemporaryFolder();
    return !folder.empty() && Create(folder, extension, kModeOfOwner);
}

bool CPrivateFile::Write(std::string_view text)
{
    return m_iFile >= 0 && SetFileSize(m_iFile, 0) && WriteAllAt(m_iFile, text, 0);
}

void CPrivateFile::Remove()
{
    // Deleted while it is still locked; otherwise another program could delete it at the same time.
    if (m_iFile >= 0)
        RemoveFile(m_kPath.c_str());
    Release();
}

void CPrivateFile::Release()
{
    if (m_iFile >= 0)
        CloseFile(std::exchange(m_iFile, -1));
    RemoveLiveName(std::exchange(m_iLiveName, -1));
    m_kPath.clear();
}

} // namespace gw
