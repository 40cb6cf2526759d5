#pragma once

#include "CFailure.h"
#include "CPrivateFile.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <span>
#include <string>
#include <string_view>

namespace gw {

/// Replaces a file in one step: bytes go to a private file in the same folder, and Commit renames it over the
/// destination. Without a Commit, or when anything failed, the old file stays as it was and the private one
/// is removed. A symbolic link is followed. A file that is replaced keeps its group and its permissions, but
/// not its set-id bits.
class CSafeFile
{
public:
    CSafeFile() = default;
    ~CSafeFile();
    CSafeFile(const CSafeFile&) = delete;
    CSafeFile& operator=(const CSafeFile&) = delete;

    /// Starts writing beside a destination. False when the folder takes no file or the destination is none
    /// that may be replaced (a folder, a read-only file).
    bool Open(const std::string& path);
    /// Writes all bytes; false when the file system does not take them, and Commit will then fail too.
    bool Write(std::string_view text);
    bool Write(std::span<const std::byte> bytes);
    /// Replaces bytes that were written already, from an offset on; false as above.
    bool Rewrite(uint64_t offset, std::span<const std::byte> bytes);
    /// Syncs and renames. False leaves the destination untouched.
    bool Commit();
    /// Why Open or Commit returned false: Exists when a file may not be replaced, otherwise WriteError.
    EFailure Failure() const { return m_eFailure; }
    /// Where the bytes lie before Commit.
    const std::string& PrivatePath() const { return m_kPrivate.Path(); }

    /// Answers whether the file under a private path, which has all its bytes, may take its place.
    using CommitGate = std::function<bool(const std::string& privatePath)>;
    /// From now on Commit asks before it renames; false fails it. The gate belongs to the process: a program
    /// that works ahead holds back here what is out of turn. An empty gate lets everything pass.
    static void SetCommitGate(CommitGate gate);
    /// From now on, files that replace nothing are not synced one by one: their writing is only begun, and
    /// the program syncs them all later, before it claims that they are saved. A file that replaces another
    /// is still synced first, because a power failure could otherwise cost both.
    static void DeferSyncs(bool deferred) { ms_bSyncsDeferred = deferred; }
    /// The next Open of a path, spelled the same, replaces nothing there: neither what it finds, a link
    /// included, nor what appears before Commit.
    static void KeepExisting(const std::string& path);

private:
    bool MayReplace();
    bool KeepOwnership();
    bool Sync() const;
    bool Rename();
    void Discard();

    static CommitGate ms_kCommitGate;
    static bool ms_bSyncsDeferred;
    std::string m_kPath;
    CPrivateFile m_kPrivate;
    EFailure m_eFailure = EFailure::None;
    unsigned m_uiMode = 0;  // of the file to be replaced; 0 if there is none
    unsigned m_uiGroup = 0; // likewise
    bool m_bKeeps = false;  // nothing may be replaced
    bool m_bFailed = false;
};

} // namespace gw
