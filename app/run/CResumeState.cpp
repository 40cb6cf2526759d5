// Keeps the state of a run as lines of JSON that are only appended. A crash can cut the last line or lose
// lines, but cannot change earlier ones; CResumeState.h has the rules that make this safe.

#include "CResumeState.h"

#include "CJsonMembers.h"
#include "CMappedFile.h"
#include "Files.h"
#include "JsonText.h"
#include "Paths.h"
#include "Text.h"

#include <algorithm>

namespace gw {

namespace {

constexpr std::string_view kPrefix = ".gaitwright.resume.";
constexpr std::string_view kExtension = ".jsonl";
// JSON strings cannot contain this text, because they escape quotes
constexpr std::string_view kSynced = R"({"synced":true})";

// Returns a name as stored in JSON, which cannot hold bytes that are not UTF-8.
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
    const size_t synced = rest.rfind(kSynced);
    const char* const syncedEnd = rest.data() + (synced == rest.npos ? 0 : synced);
    for (std::string_view line; NextLine(rest, line);)
        TakeLine(line, line.data() < syncedEnd);
}

void CResumeState::TakeLine(std::string_view line, bool isSynced)
{
    CJsonMembers json;
    std::string output;
    if (json.Read(line) != EFailure::None || !json.TakeText("output", output))
        return;
    std::vector<Made>& made = m_kMade[Kept(output)];
    Made entry;
    if (!json.TakeText("digits", entry.digits))
        return;
    if (!json.TakeText("key", entry.key) || !json.TakeText("told", entry.told))
        entry.key.clear();
    // Earlier versions synced each result before writing its line.
    if (!isSynced && json.TakeText("modified", entry.modified))
        m_bUnsynced = true;
    made.push_back(std::move(entry));
}

bool CResumeState::Knows(const std::string& output) const
{
    return m_kMade.contains(Kept(output));
}

bool CResumeState::IsOwn(const std::string& output, const std::string& digits,
                         const std::string& modified) const
{
    const auto found = m_kMade.find(Kept(output));
    return found != m_kMade.end() && std::ranges::any_of(found->second, [&](const Made& entry) {
               return entry.digits == digits || (!entry.modified.empty() && entry.modified == modified);
           });
}

const std::string* CResumeState::FindTold(const std::string& output, const std::string& key,
                                          const std::string& digits) const
{
    const auto found = m_kMade.find(Kept(output));
    if (found == m_kMade.end() || digits.empty())
        return nullptr;
    const auto made = std::ranges::find_if(
        found->second, [&](const Made& entry) { return entry.key == key && entry.digits == digits; });
    return made == found->second.end() ? nullptr : &made->told;
}

bool CResumeState::AddReady(const std::string& output, const std::string& digits, const std::string& modified)
{
    return m_kFile.AddLine(
        CJsonLine().Add("output", output).Add("digits", digits).Add("modified", modified).Text());
}

bool CResumeState::AddMade(const std::string& output, const std::string& key, const std::string& digits,
                           const std::string& modified, const std::string& told)
{
    return m_kFile.AddLine(CJsonLine()
                               .Add("output", output)
                               .Add("key", key)
                               .Add("digits", digits)
                               .Add("modified", modified)
                               .Add("told", told)
                               .Text());
}

bool CResumeState::AddSynced()
{
    return m_kFile.AddLine(kSynced);
}

std::string ModificationDigits(const std::string& path)
{
    constexpr int64_t kSecond = 1'000'000'000;
    FileStatus status;
    if (!StatusOf(path, status))
        return {};
    return std::to_string(status.modified / kSecond) + '.' + std::to_string(status.modified % kSecond);
}

} // namespace gw
