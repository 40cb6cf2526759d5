// Which source gets a draft must not depend on which worker is faster. So every job declares, in memory that
// the workers share, whether it needs a draft and of which skeleton. A job that needs one waits until all
// earlier jobs have declared themselves, and until those of the same skeleton have drafted. This ends: jobs
// are given out in order, the earliest one waits for nobody, and the program settles the jobs of workers that
// died.

#include "CDraftShelf.h"

#include "CPrivateFile.h"
#include "Paths.h"
#include "SystemError.h"

#include <cerrno>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <functional>
#include <new>
#include <thread>

#include <sys/mman.h>
#include <unistd.h>

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
    if (fsync(file.File()) == 0 && (link(file.Path().c_str(), path.c_str()) == 0 || errno == EEXIST))
        return true;
    const bool isRenamed = rename(file.Path().c_str(), path.c_str()) == 0; // no hard links here
    if (isRenamed)
        file.Release();
    else
        KeepSystemError();
    return isRenamed;
}

// For a destructor: without memory, the folder stays.
void RemoveFolder(const std::string& folder) noexcept
{
    try
    {
        std::error_code error;
        std::filesystem::remove_all(folder, error);
    } catch (const std::bad_alloc&)
    {
    }
}

} // namespace

CDraftShelf::CDraftShelf(std::string folder, size_t jobCount)
    : m_kFolder(WithSeparator(std::move(folder))), m_bTemporary(m_kFolder.empty()), m_iOwner(getpid()),
      m_uiJobCount(jobCount)
{
    void* const shared = mmap(nullptr, jobCount * sizeof(State) + 1, PROT_READ | PROT_WRITE,
                              MAP_SHARED | MAP_ANONYMOUS, -1, 0);
    if (shared != MAP_FAILED) // all zero
        m_pkStates = static_cast<State*>(shared);
    // Before any worker starts, since all must know it.
    if (m_bTemporary)
        OpenFolder();
}

CDraftShelf::~CDraftShelf()
{
    if (m_pkStates)
        munmap(static_cast<void*>(m_pkStates), m_uiJobCount * sizeof(State) + 1);
    if (m_bTemporary && !m_kFolder.empty() && m_iOwner == getpid())
        RemoveFolder(m_kFolder);
}

bool CDraftShelf::OpenFolder()
{
    if (!m_kFolder.empty())
        return CreateFolder(m_kFolder);
    std::string path = TemporaryFolder() + "gaitwright-drafts-XXXXXX";
    if (mkdtemp(path.data()))
        m_kFolder = WithSeparator(path);
    else
        KeepSystemError();
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
