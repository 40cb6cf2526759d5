// Which source gets a draft must not depend on which worker is faster. So every job declares, in memory that
// the workers share, whether it needs a draft and of which skeleton. A job that needs one waits until all
// earlier jobs have declared themselves, and until those of the same skeleton have drafted. This ends: jobs
// are given out in order, the earliest one waits for nobody, and the program settles the jobs of workers that
// died.

#include "CDraftShelf.h"

#include "CPrivateFile.h"
#include "Files.h"
#include "NativePath.h"
#include "Paths.h"
#include "Processes.h"
#include "SystemError.h"
#include "TemporaryFiles.h"

#include <chrono>
#include <filesystem>
#include <functional>
#include <new>
#include <thread>

namespace gw {

namespace {

constexpr std::string_view kProfileExtension = ".prf";
constexpr unsigned kMode = 0666; // minus the user's umask

// States of a job; all other values are the skeleton of which it needs a draft.
constexpr uint64_t kUnknown = 0;
constexpr uint64_t kSettled = 1;

std::string Ending(std::string_view skeleton)
{
    return '.' + std::string(skeleton.substr(0, 12)) + std::string(kProfileExtension);
}

uint64_t HashOf(std::string_view skeleton)
{
    return std::hash<std::string_view>()(skeleton) | 2u; // neither of the constants above
}

// Without a lock on the name: of two programs that draft the same skeleton, the first one wins.
bool Publish(const std::string& folder, const std::string& path, std::string_view text)
{
    CPrivateFile file;
    if (!file.Create(folder, ".tmp", kMode) || !WriteAll(file.File(), text))
        return false;
    if (SyncFile(file.File()) && RenameToFree(file.Path(), path))
    {
        file.Release();
        return true;
    }
    if (IsNameTaken(LastSystemError()))
        return true;
    KeepSystemError();
    return false;
}

// For a destructor: without memory, the folder stays.
void RemoveTree(const std::string& folder) noexcept
{
    try
    {
        std::error_code error;
        std::filesystem::remove_all(NativePath(folder), error);
    } catch (const std::bad_alloc&)
    {
    }
}

} // namespace

CDraftShelf::CDraftShelf(std::string folder, size_t jobCount)
    : m_kFolder(WithSeparator(std::move(folder))), m_bTemporary(m_kFolder.empty()),
      m_uiOwner(ProcessNumber()), m_uiJobCount(jobCount), m_kMemory(jobCount * sizeof(State) + 1),
      m_pkStates(static_cast<State*>(m_kMemory.Get()))
{
    // Before any worker starts, since all must know it.
    if (m_bTemporary)
        OpenFolder();
}

CDraftShelf::~CDraftShelf()
{
    if (m_bTemporary && !m_kFolder.empty() && m_uiOwner == ProcessNumber())
        RemoveTree(m_kFolder);
}

bool CDraftShelf::OpenFolder()
{
    if (!m_kFolder.empty())
        return CreateFolder(m_kFolder);
    m_kFolder = CreateTemporaryFolder("drafts");
    return !m_kFolder.empty();
}

void CDraftShelf::Settle(size_t job)
{
    if (m_pkStates)
        m_pkStates[job].store(kSettled, std::memory_order_release);
}

void CDraftShelf::WaitForEarlier(uint64_t asked)
{
    for (size_t earlier = 0; earlier < m_uiJob; ++earlier)
    {
        for (;;)
        {
            const uint64_t state = m_pkStates[earlier].load(std::memory_order_acquire);
            if (state != kUnknown && state != asked)
                break;
            std::this_thread::sleep_for(std::chrono::milliseconds(1));
        }
    }
}

std::string CDraftShelf::Find(std::string_view skeleton)
{
    if (m_pkStates)
    {
        const uint64_t asked = HashOf(skeleton);
        m_pkStates[m_uiJob].store(asked, std::memory_order_release);
        WaitForEarlier(asked);
    }
    std::string found = FindFile(skeleton);
    if (!found.empty())
        Settle(m_uiJob);
    return found;
}

std::string CDraftShelf::FindFile(std::string_view skeleton) const
{
    const std::string ending = Ending(skeleton);
    for (const std::string& name : FilesInFolder(m_kFolder, kProfileExtension))
    {
        if (name.ends_with(ending))
            return m_kFolder + name;
    }
    return {};
}

std::string CDraftShelf::Keep(std::string_view skeleton, std::string_view stem, std::string_view text)
{
    const std::string name = std::string(stem) + Ending(skeleton);
    const bool isWritten = OpenFolder() && Publish(m_kFolder, m_kFolder + name, text);
    Settle(m_uiJob);
    return isWritten ? m_kFolder + name : std::string();
}

} // namespace gw
