#pragma once

#include "CReportFile.h"

#include <string>
#include <unordered_map>
#include <vector>

namespace gw {

/// What earlier runs made, in files beside their results: a second run knows by it what is left to do.
/// Several runs into one folder may go at the same time, each with a state of its own name; every run reads
/// all.
class CResumeState
{
public:
    /// Reads what is known of a folder. Lines that a dying writer left cut are passed over.
    void Read(const std::string& folder);
    /// Begins or continues the state of a name in a folder. False when it cannot be written.
    bool Open(const std::string& folder, const std::string& name);

    /// Whether an output is known to have been begun: what lies there is no stranger's.
    bool Knows(const std::string& output) const;
    /// What was told of an output that was made under a key and had some content; null where none was. The
    /// present content is the caller's to compare: its digits are asked for.
    const std::string* FindTold(const std::string& output, const std::string& key,
                                const std::string& digits) const;

    /// Keeps that an output will be written. False when the file system takes no more.
    bool AddBegun(const std::string& output);
    /// Keeps that it was, under which key, with which content, and what is to be told of it.
    bool AddMade(const std::string& output, const std::string& key, const std::string& digits,
                 const std::string& told);

private:
    struct Made
    {
        std::string key;
        std::string digits;
        std::string told;
    };

    void ReadFile(const std::string& path);
    void TakeLine(std::string_view line);

    CReportFile m_kFile;
    std::unordered_map<std::string, std::vector<Made>>
        m_kMade; ///< by output; none of one that was only begun
};

} // namespace gw
