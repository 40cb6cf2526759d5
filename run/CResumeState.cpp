#include "CResumeState.h"

#include "CJsonMembers.h"
#include "CMappedFile.h"
#include "JsonText.h"
#include "Paths.h"
#include "Text.h"

#include <algorithm>

namespace gw {

namespace {

constexpr std::string_view kPrefix = ".gaitwright.resume.";
constexpr std::string_view kExtension = ".jsonl";

// A name as the state knows it: JSON, which keeps no bytes that are no UTF-8.
std::string Kept(const std::string& output)
{
    return JsonString(output);
}

} // namespace

void CResumeState::Read(const std::string& folder)
{
    for (const std::string& file : FilesInFolder(folder.empty() ? "." : folder, kExtension))
    {
        if (file.starts_with(kPrefix))
            ReadFile(WithSeparator(folder) + file);
    }
}

bool CResumeState::Open(const std::string& folder, const std::string& name)
{
    return m_kFile.Open(WithSeparator(folder) + std::string(kPrefix) + name + std::string(kExtension),
                        CReportFile::EStart::AtEnd);
}

void CResumeState::ReadFile(const std::string& path)
{
    CMappedFile file;
    if (file.Open(path) != EFailure::None)
        return;
    std::string_view rest = file.Text();
    for (std::string_view line; NextLine(rest, line);)
        TakeLine(line);
}

void CResumeState::TakeLine(std::string_view line)
{
    CJsonMembers json;
    std::string output;
    if (json.Read(line) != EJsonFault::None || !json.TakeText("output", output))
        return;
    std::vector<Made>& made = m_kMade[Kept(output)];
    Made entry;
    if (json.TakeText("key", entry.key) && json.TakeText("digits", entry.digits) &&
        json.TakeText("told", entry.told))
        made.push_back(std::move(entry));
}

bool CResumeState::Knows(const std::string& output) const
{
    return m_kMade.contains(Kept(output));
}

const std::string* CResumeState::FindTold(const std::string& output, const std::string& key,
                                          const std::string& digits) const
{
    const auto found = m_kMade.find(Kept(output));
    if (found == m_kMade.end())
        return nullptr;
    const auto made = std::ranges::find_if(
        found->second, [&](const Made& entry) { return entry.key == key && entry.digits == digits; });
    return made == found->second.end() ? nullptr : &made->told;
}

bool CResumeState::AddBegun(const std::string& output)
{
    return m_kFile.AddLine(CJsonLine().Add("output", output).Text());
}

bool CResumeState::AddMade(const std::string& output, const std::string& key, const std::string& digits,
                           const std::string& told)
{
    return m_kFile.AddLine(
        CJsonLine().Add("output", output).Add("key", key).Add("digits", digits).Add("told", told).Text());
}

} // namespace gw
