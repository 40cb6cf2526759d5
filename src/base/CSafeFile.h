#pragma once

#include "CFailureRecord.h"
#include "CPrivateFile.h"

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <functional>
#include <span>
#include <string>
#include <string_view>

namespace gw {

/// Replaces a file atomically: bytes go to a private file in the same folder, and Commit renames it over the
/// destination. Without a Commit, or after a failure, the old file is unchanged and the private one is
/// deleted. Symbolic links are followed. A replaced file keeps its group and permissions, but not its set-id
/// bits.
class CSafeFile
{
public:
    CSafeFile() = default;
    ~CSafeFile();
    CSafeFile(const CSafeFile&) = delete;
    CSafeFile& operator=(const CSafeFile&) = delete;

    /// Starts writing next to a destination. Returns false if the folder is not writable or the destination
    /// must not be replaced (a folder, a read-only file).
    bool Open(const std::string& path);
    /// Writes all bytes. If that fails, returns false, and Commit will fail too.
    bool Write(std::string_view text);
    bool Write(std::span<const std::byte> bytes);
    /// Overwrites bytes already written, starting at an offset. If that fails, returns false, and Commit will
    /// fail too.
    bool Rewrite(uint64_t offset, std::span<const std::byte> bytes);
    /// Syncs and renames. If that fails, returns false and leaves the destination unchanged.
    bool Commit();
    /// Returns why Open or Commit failed: Exists if the file must not be replaced, otherwise WriteError.
    EFailure Failure() const { return m_eFailure; }
    /// Returns the path of the bytes before Commit.
    const std::string& PrivatePath() const { return m_kPrivate.Path(); }

    /// Returns whether the file at a private path, now complete, may replace its destination.
    using CommitGate = std::function<bool(const std::string& privatePath)>;
    /// Sets a gate for the whole process: Commit calls it before it renames, and fails if it returns false. A
    /// program that works ahead uses it to hold back files that are out of turn. An empty gate allows
    /// everything.
    static void SetCommitGate(CommitGate gate);
    /// Defers the sync of files that replace nothing: their writing to disk is only started, and the program
    /// must sync them all before it reports them as saved. A file that replaces another is still synced
    /// first, because a power failure could otherwise lose both.
    static void DeferSyncs(bool deferred) { ms_bSyncsDeferred = deferred; }
    /// Makes the next Open of this path, spelled the same, fail rather than replace anything: neither an
    /// existing file or link nor one that appears before Commit.
    static void KeepExisting(const std::string& path);
    /// Takes that back, if the path has not been opened since.
    static void ReplaceExisting(const std::string& path);

private:
    bool MayReplace();
    bool KeepPermissions() const;
    bool Sync() const;
    bool Rename();
    void Discard();

    static CommitGate ms_kCommitGate;
    static bool ms_bSyncsDeferred;
    std::string m_kPath;
    CPrivateFile m_kPrivate;
    EFailure m_eFailure = EFailure::None;
    unsigned m_uiMode = 0;  // of the file to be replaced; 0 if it does not exist
    unsigned m_uiGroup = 0; // of the file to be replaced; 0 if it does not exist
    bool m_bKeeps = false;  // existing files must not be replaced
    bool m_bFailed = false;
};

/// Returns a stream of the C library that writes text to a file, with the platform's line ends; null on
/// failure. Close it before the Commit; it fails if a write has failed.
std::FILE* TextStreamTo(CSafeFile& file);

} // namespace gw
