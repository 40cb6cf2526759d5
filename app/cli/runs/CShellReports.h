#pragma once

#include "CFileConversion.h"
#include "Words.h"

#include <vector>

namespace gw {

struct ShellOptions;

/// What a conversion reports: said on standard error as it comes, and kept, but for the program's fixed
/// messages, which programs need not be told.
class CShellReports
{
public:
    /// The options must outlive the reports.
    explicit CShellReports(const ShellOptions& options) : options_(options) {}

    void Add(const CReport& report)
    {
        SayReport(options_, report);
        if (report.code == kFixedMessage)
            return;
        reports_.push_back(report);
        hasFailed_ = hasFailed_ || !report.warning;
    }
    /// Whether anything was reported that is no warning.
    bool HasFailed() const { return hasFailed_; }
    /// Everything that was reported, in order.
    const std::vector<CReport>& All() const { return reports_; }

private:
    const ShellOptions& options_;
    std::vector<CReport> reports_;
    bool hasFailed_ = false;
};

} // namespace gw
