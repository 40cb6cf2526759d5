#pragma once

#include "CFileConversion.h"
#include "Words.h"

#include <vector>

namespace gw {

struct ShellOptions;

/// The reports of a conversion: printed to standard error immediately and kept, except for the program's
/// fixed messages, which other programs do not need.
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
    /// Returns whether anything other than warnings was reported.
    bool HasFailed() const { return hasFailed_; }
    /// Returns all reports, in order.
    const std::vector<CReport>& All() const { return reports_; }

private:
    const ShellOptions& options_;
    std::vector<CReport> reports_;
    bool hasFailed_ = false;
};

} // namespace gw
