#pragma once

#include "CFileRun.h"
#include "CheckResult.h"
#include "Notice.h"
#include "ResultFile.h"

#include <optional>
#include <span>

namespace gw {

class CShellConversion;
class CShellNotices;

/// The desktop program's batch run: one profile for all files, chosen before the run starts, with its own
/// messages. Every worker inherits the conversion as it is when the worker starts.
class CBatchRun : public CFileRun
{
public:
    /// Conversion, notices and options must outlive the run.
    CBatchRun(const ShellOptions& options, Jobs jobs, RunState state, CShellConversion& conversion,
              CShellNotices& notices);

    /// Returns all notices about the files, in order.
    const std::vector<Notice>& Notices() const { return m_kNotices; }
    /// Returns the number of files that were started.
    size_t TakenCount() const { return m_uiTaken; }
    const CShellConversion& Conversion() const { return conversion_; }

protected:
    FileEnd Convert(const ShellOptions& options, size_t index, std::FILE* record) override;
    void TellLost(size_t index, const Notice& reason, std::FILE* record) override;
    void TellUpToDate(size_t index) override;
    bool AddProfiles(CContentHash& key) override;
    void TakeRecord(size_t index, EConversion outcome, std::string_view record,
                    std::string_view enclosure) override;
    bool TellEnd() override;

private:
    EBatchStep RunJob(const ConversionJob& job);
    EBatchStep ConvertMotion(const ConversionJob& job);
    void WriteRecord(size_t index, EConversion outcome, std::span<const Notice> notices, std::FILE* record);

    CShellConversion& conversion_;
    CShellNotices& ownNotices_;               ///< of this process
    std::optional<MeasuredConversion> check_; ///< in a worker: of the current source, with --check
    std::vector<Notice> m_kNotices;
    size_t m_uiTaken = 0;
};

/// Returns the job for the option --job.
EBatchJob BatchJobOf(const ShellOptions& options);
/// Selects the profile of a batch run, if it needs one: the one in the options or, without, the one that
/// `convert` would choose for the first file. Returns false, after reporting the reason, if none can be used.
bool SelectBatchProfile(const ShellOptions& options, CShellConversion& conversion, const std::string& first);

} // namespace gw
