#pragma once

#include "CReportFile.h"

#include <string>
#include <unordered_map>
#include <vector>

namespace gw {

/// What earlier runs made, in files beside their results: a second run learns from it what is left to do.
/// Several runs into one folder may go at the same time, each with a state of its own name; every run reads
/// all of them.
///
/// A run of many files syncs its results once, at its end. These rules keep the state true through a crash:
/// - The hash of a result and its time of modification are written before it takes its place. So whatever a
///   killed run left under a result's name can be recognized as its own.
/// - A result that was made is reused only if its bytes still have that hash. So a line that reached the disk
///   before its result claims nothing.
/// - AddSynced comes after the sync, and only from then on a line claims that the result is durable. Up to
///   there, other bytes with the recorded time are what a power failure left of it, and are replaced.
/// - Any other bytes were written by somebody else, and are kept.
class CResumeState
{
public:
    /// Reads what is known of a folder. Lines that a dying writer left cut are passed over.
    void Read(const std::string& folder);
    /// Begins or continues the state of a name in a folder. False when it cannot be written.
    bool Open(const std::string& folder, const std::string& name);

    /// Whether a run ever wrote this output.
    bool Knows(const std::string& output) const;
    /// Whether an output with these digits and this time of modification is what a run left there, and not
    /// somebody's work since.
    bool IsOwn(const std::string& output, const std::string& digits, const std::string& modified) const;
    /// Whether a run ended before it synced its results.
    bool HasUnsynced() const { return m_bUnsynced; }
    /// What was told of an output that was made under a key and has these digits now; null if none was.
    const std::string* FindTold(const std::string& output, const std::string& key,
                                const std::string& digits) const;

    /// Keeps what takes the place of an output next. False when the file system takes no more.
    bool AddReady(const std::string& output, const std::string& digits, const std::string& modified);
    /// Keeps that it did, under which key it was made, and what is to be told of it.
    bool AddMade(const std::string& output, const std::string& key, const std::string& digits,
                 const std::string& modified, const std::string& told);
    /// Keeps that all of the above is on the disk, which the caller has seen to.
    bool AddSynced();

private:
    struct Made
    {
        std::string key; ///< empty for one of which only AddReady told
        std::string digits;
        std::string modified; ///< empty once the output is on the disk
        std::string told;
    };

    void ReadFile(const std::string& path);
    void TakeLine(std::string_view line, bool isSynced);

    CReportFile m_kFile;
    std::unordered_map<std::string, std::vector<Made>>
        m_kMade; ///< by output; none for one that an earlier version only began
    bool m_bUnsynced = false;
};

/// When a file was last written, as digits for a state; empty if there is none.
std::string ModificationDigits(const std::string& path);

} // namespace gw
