// What a user can do about a failure or a warning, as options and commands of this program. The notices
// themselves are shared with the window, which has no command line.

#include "HelpWords.h"

#include "CFileExam.h"
#include "FindingWords.h"
#include "Paths.h"
#include "ShellOptions.h"
#include "Text.h"

#include <algorithm>
#include <string_view>

namespace gw {

namespace {

constexpr std::string_view kPlainCharacters =
    "abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ0123456789._-/+,:@%=";

constexpr std::string_view kMendingHelp = "\n  --mend reads the file repaired; for a repaired copy: ";

// Codes of warnings about what --align corrects.
constexpr std::string_view kAlignedCodes[] = {"rest-pose", "turned-at-rest", "doubled-offsets"};

bool IsOf(EFailure reason, const Notice& notice)
{
    return FindingCode({.reason = reason}) == notice.code;
}

// Returns whether a reader refused the text of a file, which an examination may explain and repair.
bool IsOfText(const Notice& notice)
{
    for (auto reason = EFailure::BadHeader; IsOfReader(reason);
         reason = static_cast<EFailure>(static_cast<int>(reason) + 1))
    {
        if (IsOf(reason, notice))
            return true;
    }
    return false;
}

std::string MendingHelp(const Notice& notice)
{
    const std::string source = ShellWord(notice.path);
    CFileExam exam;
    exam.ExamineBVH(notice.path);
    if (!exam.Findings().MendsAny())
        return "\n  for all faults: gaitwright doctor " + source;
    const PathParts parts = SplitPath(notice.path);
    return "\n  --mend reads the file repaired; for a repaired copy: gaitwright doctor " + source +
           " --fix " + ShellWord(parts.stem + "-fixed" + parts.extension);
}

std::string FailureHelp(const ShellOptions& options, const Notice& notice)
{
    const std::string source = ShellWord(notice.path);
    if (notice.code == "misfit" && notice.words.ends_with(" more"))
        return ", see 'gaitwright profiles " + source + "'";
    if (IsOf(EFailure::UnknownFormat, notice) && HasExtension(notice.path, ".Kinetra"))
        return "\n  to get the motion out of it: gaitwright extract " + source + " -o " +
               ShellWord(SplitPath(notice.path).stem + ".htr");
    if (!options.mend && HasExtension(notice.path, ".bvh") && IsOfText(notice))
        return MendingHelp(notice);
    return {};
}

} // namespace

bool NamesMending(const Notice& notice)
{
    return notice.words.find(kMendingHelp) != notice.words.npos;
}

std::string ShellWord(const std::string& path)
{
    std::string text = Printable(path);
    if (!text.empty() && text.find_first_not_of(kPlainCharacters) == text.npos && text.front() != '-')
        return text;
    std::string quoted = "'";
    for (const char c : text)
        quoted += c == '\'' ? std::string("'\\''") : std::string(1, c);
    return quoted + '\'';
}

Notice WithHelp(const ShellOptions& options, Notice notice)
{
    const bool isAligned = std::ranges::find(kAlignedCodes, notice.code) != std::end(kAlignedCodes);
    if (!notice.IsWarning())
        notice.words += FailureHelp(options, notice);
    else if (isAligned && !options.align)
        notice.words += "; --align corrects this";
    return notice;
}

} // namespace gw
