#pragma once

#include "CConversionPage.h"
#include "CFileRun.h"

namespace gw {

/// Converts many independent files, for `convert`.
class CConversionRun : public CFileRun
{
public:
    using CFileRun::CFileRun;

protected:
    FileEnd Convert(const ShellOptions& options, size_t index, std::FILE* record) override;
    void TellLost(size_t index, const Notice& reason, std::FILE* record) override;
    void TellUpToDate(size_t index) override;
    bool AddProfiles(CContentHash& key) override;
    std::string Enclosure() override;
    void TakeRecord(size_t index, EConversion outcome, std::string_view record,
                    std::string_view enclosure) override;
    bool TellEnd() override;

private:
    bool FinishPage();

    std::string m_kDrawn; ///< in a worker: the page part of the last conversion
    CConversionPage m_kPage;
    size_t m_uiTaken = 0;
};

} // namespace gw
