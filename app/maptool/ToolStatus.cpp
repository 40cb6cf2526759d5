// The sentences of the map tool's status line.

#include "ToolStatus.h"

#include "CMotionFile.h"
#include "FindingWords.h"
#include "Paths.h"
#include "Text.h"

#include <algorithm>
#include <iterator>
#include <string_view>

namespace gw {

namespace {

std::string FileName(const std::string& path)
{
    const PathParts parts = SplitPath(path);
    return parts.stem + parts.extension;
}

std::string Counted(size_t count, const char* thing)
{
    return std::to_string(count) + ' ' + thing + (count == 1 ? "" : "s");
}

std::string FrameCount(const CMotionFile& motion)
{
    return Counted(static_cast<size_t>(motion.GetKeyCount()), "frame");
}

// Reasons with a different meaning when saving than when loading.
struct SaveWords
{
    EFailure m_eReason;
    std::string_view m_kWords;
};

constexpr SaveWords kSaveWords[] = {
    {EFailure::UnknownFormat, "results are written as .htr only"                            },
    {EFailure::NoRoot,        "the target has no rest pose; load an .htr file as the target"},
};

} // namespace

std::string LoadedWords(const std::string& path, const CMotionFile& motion, const CFailureRecord& record)
{
    std::string words = Printable(FileName(path)) + ": " + FrameCount(motion);
    if (!record.Warnings().empty())
        words += "; " + MakeNotice(path, record.Warnings().front()).words;
    return words;
}

std::string FailedWords(const std::string& path, const Finding& failure)
{
    return NoticeLine(MakeNotice(FileName(path), failure));
}

std::string NotSavedWords(const std::string& path, const Finding& failure)
{
    const auto* const found = std::ranges::find(kSaveWords, failure.reason, &SaveWords::m_eReason);
    const std::string why =
        found == std::end(kSaveWords) ? MakeNotice(path, failure).words : std::string(found->m_kWords);
    return "Not saved: " + Printable(FileName(path)) + ": " + why;
}

std::string ConvertedWords(const CMotionFile& result, const CFailureRecord& record)
{
    if (record.Failure())
        return "Not converted: " + MakeNotice({}, record.Failure()).words;
    const std::string words = "Converted " + FrameCount(result);
    return record.Warnings().empty() ? words : words + "; " + MakeNotice({}, record.Warnings().front()).words;
}

std::string SavedWords(const std::string& path)
{
    return "Saved " + Printable(FileName(path));
}

std::string MapWords(const std::string& path, size_t lineCount, size_t leftOut)
{
    std::string words = Printable(FileName(path)) + ": " + Counted(lineCount, "line");
    if (leftOut > 0)
        words += "; " + Counted(leftOut, "mapping") + " without a bone here left out";
    return words;
}

std::string NoMapWords(const std::string& path)
{
    return Printable(FileName(path)) + ": this cannot be opened, or is longer than any map";
}

std::string PrunedWords(size_t lineCount)
{
    return lineCount == 0 ? std::string()
                          : "; " + Counted(lineCount, "map line") + " without bones here removed";
}

} // namespace gw
