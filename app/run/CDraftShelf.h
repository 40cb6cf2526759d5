#pragma once

#include "CSharedMemory.h"

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace gw {

/// Identifies a CDraftShelf to other processes.
struct DraftShelfLink
{
    std::string folder;
    bool isTemporary = false;
    std::string memory; ///< name of the shared memory
    size_t jobCount = 0;
};

/// Drafted profiles, one per skeleton, shared by the workers of a run. The first source of a skeleton, in the
/// order of the run, gets a draft; all later ones use it, no matter which worker is faster. The drafts are
/// files in a folder. Drafts of earlier runs in the same folder are used too.
///
/// A skeleton is named by its digits, which end its file's name: "walk.0123456789ab.prf".
class CDraftShelf
{
public:
    /// Keeps the drafts in a folder, which is created with the first one. An empty folder means a temporary
    /// one, which is deleted with the object. `jobCount` is the number of sources.
    CDraftShelf(std::string folder, size_t jobCount);
    /// Shares the shelf of another process, on systems that cannot copy a process.
    explicit CDraftShelf(const DraftShelfLink& link);
    ~CDraftShelf();
    CDraftShelf(const CDraftShelf&) = delete;
    CDraftShelf& operator=(const CDraftShelf&) = delete;

    /// Returns whether the drafts outlive the object.
    bool IsKept() const { return !m_bTemporary; }
    /// Returns how another process can share the shelf as long as it exists.
    DraftShelfLink Link() const;

    /// Starts a job in this process.
    void Begin(size_t job) { m_uiJob = job; }
    /// Declares that a job needs no draft, has one, or has ended. Until a job is settled or has asked for a
    /// draft of another skeleton, later jobs that need one wait for it. Can be called in any process.
    void Settle(size_t job);
    void SettleCurrent() { Settle(m_uiJob); }
    /// Returns the draft for the current job's skeleton; waits until no earlier job can provide it. If
    /// the result is empty, the job must make the draft, and keep it or settle.
    std::string Find(std::string_view skeleton);
    /// Writes a draft, settles the current job, and returns the draft's path. `stem` begins the file's name.
    /// If it cannot be written, returns an empty path; see TakeSystemError.
    std::string Keep(std::string_view skeleton, std::string_view stem, std::string_view text);

private:
    using State = std::atomic<uint64_t>;

    void WaitForEarlier(uint64_t asked);
    std::string FindFile(std::string_view skeleton) const;
    bool OpenFolder();

    std::string m_kFolder;
    bool m_bTemporary;
    uint32_t m_uiOwner; ///< the process that created a temporary folder
    size_t m_uiJobCount;
    size_t m_uiJob = 0;
    CSharedMemory m_kMemory;     ///< that all workers share
    State* m_pkStates = nullptr; ///< in that memory, one per job; null without it
};

} // namespace gw
