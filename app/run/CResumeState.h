#pragma once

#include "CReportFile.h"

#include <string>
#include <unordered_map>
#include <vector>

namespace gw {

/// The results of earlier runs, in files next to the results: another run reads them to see what is left to
/// do. Several runs can write into one folder at the same time, each with its own state file; every run reads
/// all of them.
///
/// A run of many files syncs its results once, at its end. These rules keep the state correct through a
/// crash:
/// - The hash and modification time of a result are written before it takes its place. So whatever a killed
/// run left under a result's name can be recognized as its own.
/// - A result is reused only if its bytes still have that hash. So a line that reached the disk before its
/// result claims nothing.
/// - AddSynced follows the sync, and only after it a line claims that the result is durable. Before that,
/// other bytes with the recorded time are the leftovers of a power failure, and are replaced.
/// - Any other bytes were written by somebody else, and are kept.
class CResumeState
{
public:
    /// Reads the states in a folder. Incomplete lines of a killed writer are skipped.
    void Read(const std::string& folder);
    /// Creates or continues the state with a name in a folder. Returns false if it cannot be written.
    bool Open(const std::string& folder, const std::string& name);

    /// Returns whether any run has written this output.
    bool Knows(const std::string& output) const;
    /// Returns whether an output with this hash and modification time was left by a run and not changed
    /// since.
    bool IsOwn(const std::string& output, const std::string& digits, const std::string& modified) const;
    /// Returns whether a run ended before it synced its results.
    bool HasUnsynced() const { return m_bUnsynced; }
    /// Returns the report of an output made under a key that still has this hash; null if there is none.
    const std::string* FindTold(const std::string& output, const std::string& key,
                                const std::string& digits) const;

    /// Records that a file is about to replace an output. Returns false if the state cannot be written.
    bool AddReady(const std::string& output, const std::string& digits, const std::string& modified);
    /// Records that it did, under which key, and the report about it.
    bool AddMade(const std::string& output, const std::string& key, const std::string& digits,
                 const std::string& modified, const std::string& told);
    /// Records that all of the above is on disk; the caller must have synced it.
    bool AddSynced();

private:
    struct Made
    {
        std::string key; ///< empty if only AddReady recorded it
        std::string digits;
        std::string modified; ///< empty once the output is on disk
        std::string told;
    };

    void ReadFile(const std::string& path);
    void TakeLine(std::string_view line, bool isSynced);

    CReportFile m_kFile;
    std::unordered_map<std::string, std::vector<Made>>
        m_kMade; ///< by output; no value if an earlier version only started it
    bool m_bUnsynced = false;
};

/// Returns a file's modification time as digits for a state; empty if it does not exist.
std::string ModificationDigits(const std::string& path);

} // namespace gw
