// Texts: the program's own, a library's, and messages for failures.

#include "ResourceFile.h"
#include "TempFolder.h"

#include "CResourceManager.h"
#include "FindingWords.h"
#include "StringTable.h"

#include <gtest/gtest.h>
#include <set>
#include <tuple>

namespace gw {
namespace {

constexpr uint32_t kGerman = 1031;
constexpr uint32_t kAustrian = 3079;
constexpr uint32_t kFrench = 1036;

std::string Library()
{
    return ResourceFile({
        {138, kFrench, u"Fichier invalide."},
        {138, kGerman, u"Ungültige Datei. \u20ac"},
        {139, kGerman, u"*"},
        {144, 0, u"Neutral"},
        {144, kFrench, u"Profil!"},
        {171, kGerman, u"*no text in the table either"},
        {4711, kGerman, u"new"},
    });
}

bool Find(const std::string& file, uint32_t id, uint32_t locale, std::string& text)
{
    return FindResourceString(std::as_bytes(std::span(file)), id, locale, text);
}

} // namespace

TEST(StringLibrary, StringsByIdAndLanguage)
{
    const std::string file = Library();
    // words: empty if none is found
    const std::tuple<const char*, uint32_t, uint32_t, const char*> rows[] = {
        {"the locale's own", 138, kGerman, "Ungültige Datei. \xe2\x82\xac"},
        {"another of the same language", 138, kAustrian, "Ungültige Datei. \xe2\x82\xac"},
        {"neutral before a foreign one", 144, kGerman, "Neutral"},
        {"foreign rather than none", 138, 2052, "Ungültige Datei. \xe2\x82\xac"},
        {"an empty place in a block", 140, kGerman, ""},
        {"a block that is not there", 9999, kGerman, ""},
    };
    for (const auto& [what, id, locale, words] : rows)
    {
        std::string text;
        EXPECT_EQ(Find(file, id, locale, text), *words != '\0') << what;
        EXPECT_EQ(text, words) << what;
    }
}

TEST(StringLibrary, EveryPrefixIsRefusedOrGivesTheText)
{
    const std::string whole = Library();
    for (size_t size = 0; size < whole.size(); ++size)
    {
        const std::vector<char> cut(whole.begin(),
                                    whole.begin() + static_cast<ptrdiff_t>(size)); // its own buffer
        std::string text;
        const bool found = FindResourceString(std::as_bytes(std::span(cut)), 138, kGerman, text);
        EXPECT_EQ(text, found ? "Ungültige Datei. \xe2\x82\xac" : "") << size;
    }
}

TEST(ResourceManager, AStarLeavesATextToTheProgram)
{
    const CTempFolder folder;
    WriteBytes(folder.Path("res.dll"), Library());
    CResourceManager translated, plain;
    translated.OpenLibrary(folder.Path("res.dll"), kGerman);
    plain.OpenLibrary(folder.Path("none.dll"), kGerman);
    const std::tuple<const char*, const CResourceManager&, int, bool, const char*> rows[] = {
        {"translated", translated, 138, true, "Ungültige Datei. \xe2\x82\xac"},
        {"a star", translated, 139, true, "Save convertion result?"},
        {"not in the library", translated, 137, true, "Unable to locate Kestro."},
        {"only in the library", translated, 4711, true, "new"},
        {"nowhere", translated, 1, false, ""},
        {"no library", plain, 138, true, "Invalid BVH file format."},
        {"no such message", plain, -5, false, ""},
    };
    for (const auto& [what, manager, id, found, words] : rows)
    {
        std::string text;
        EXPECT_EQ(manager.LoadResString(id, text), found) << what;
        EXPECT_EQ(text, words) << what;
    }
}

TEST(StringTable, FormatsTakeNothingButTheirArguments)
{
    const std::string arguments[] = {"2", "walk"};
    const std::tuple<const char*, const char*> rows[] = {
        {"Batch Converting %d : %s", "Batch Converting 2 : walk"},
        {"%s%s%s%s", "2walk"},
        {"100% %n %5d", "100% %n %5d"},
        {"%", "%"},
    };
    for (const auto& [format, text] : rows)
        EXPECT_EQ(FormatText(format, arguments), text);
}

TEST(FindingWords, EveryReasonHasItsOwnWordsAndEveryReadersItsOwnCode)
{
    std::set<std::string> codes, words;
    constexpr auto kLast = static_cast<size_t>(EFailure::TurnedAtRest);
    for (size_t reason = 0; reason <= kLast; ++reason)
    {
        const Notice notice = MakeNotice("a.bvh", {static_cast<EFailure>(reason)});
        if (IsOfReader(static_cast<EFailure>(reason)))
            codes.insert(notice.code);
        words.insert(notice.words);
    }
    EXPECT_EQ(codes.size(), static_cast<size_t>(EFailure::LfsPointer));
    EXPECT_EQ(words.size(), kLast + 1);
}

TEST(FindingWords, ANoticeSaysWhereAndWhatToDo)
{
    const std::tuple<const char*, const char*, Finding, const char*> rows[] = {
        {"a line",
         "a.bvh",
         {EFailure::BlankLine, 12, "Frames:"},
         "a.bvh:12: expected this keyword, but found an empty line: \"Frames:\" (remove the empty line)"},
        {"a byte of a container",
         "a.orn",
         {EFailure::UnknownClass, 381, "CSpoon"},
         "a.orn: byte 381: the file contains an object of an unknown class: \"CSpoon\""},
        {"a name that would command a terminal",
         "\x1b[2J",
         {EFailure::TooDeep, 0, "\x1b[31m"},
         "\\x1b[2J: bones or objects are nested too deeply: \"\\x1b[31m\""},
        {"the path is not said twice",
         "a.htr",
         {EFailure::NotRegular, 0, "a.htr"},
         "a.htr: this is a folder or a device, not a file"},
    };
    for (const auto& [what, path, failure, line] : rows)
        EXPECT_EQ(NoticeLine(MakeNotice(path, failure)), line) << what;
}

} // namespace gw
