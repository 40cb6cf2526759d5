#pragma once

#include "Notice.h"
#include "RunTally.h"

#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CJsonWriter;

/// What a run over many files amounts to, on one screen: how many sources had which outcome, why sources
/// failed, the first failures with their causes, and how many sources had which warnings.
class CRunSummary
{
public:
    /// Adds a source's outcome and the record about it.
    void Take(const std::string& source, EConversion outcome, std::string_view record);

    /// Prints the summary to standard error, or an object to standard output with --json. With --quiet, only
    /// failures are printed. `areFailuresTold`: they were printed when they happened.
    void Tell(const ShellOptions& options, const RunTally& tally, bool areFailuresTold) const;

private:
    /// How often a kind of notice occurred, and what to call it.
    struct Kind
    {
        size_t sources = 0;
        std::string words;
        std::string
            common; ///< the message, if it was the same for all sources: it may name the system's reason

        void Add(const Notice& notice);
    };
    using Kinds = std::map<std::string, Kind>; ///< by code
    /// Sums of a figure as it is, and as it would be.
    struct Improvement
    {
        double is = 0.0;
        double would = 0.0;
        size_t results = 0;
    };

    void TakeWarnings(const std::vector<Notice>& notices);
    void TakeCause(const std::string& source, const std::vector<Notice>& notices);
    void TakeFigures(std::string_view record);
    void Say(const ShellOptions& options, const RunTally& tally, bool areFailuresTold) const;
    void SayHelp(const ShellOptions& options) const;
    void SayBetter() const;
    void SayFailures() const;
    Notice CauseOf(const RunTally& tally) const;
    void WriteJson(const ShellOptions& options, const RunTally& tally) const;

    Kinds m_kCauses;
    Kinds m_kWarnings;
    std::vector<std::string> m_kFailed; ///< the first ones, one line each
    Notice m_kFirst;                    ///< cause of the first one
    size_t m_uiFailed = 0;
    size_t m_uiDrafted = 0;
    size_t m_uiMended = 0;
    size_t m_uiMendable = 0;                      ///< failed sources that --mend can repair
    size_t m_uiBetter = 0;                        ///< results that --align --faithful would improve
    std::map<std::string, Improvement> m_kBetter; ///< by figure
};

} // namespace gw
