// The editor's model: the effect of loading, counting and saving on rows, names and files.
#include "ProfileFixture.h"

#include "ProfileNames.h"
#include "Text.h"

#include <gmock/gmock.h>
#include <tuple>

namespace gw {

using testing::ElementsAre;

namespace {

constexpr const char* kLPelvisRow = "[FIXED]|LPelvis|0|0|0|||";
constexpr const char* kRPelvisRow = "[FIXED]|RPelvis|0|0|0|||";

std::vector<std::string> SplitAtBars(std::string_view text)
{
    std::vector<std::string> parts;
    while (!text.empty())
        parts.emplace_back(NextToken(text, "|"));
    return parts;
}

} // namespace

TEST_F(ProfileEditor, LoadReplacesRowsAndKeepsWhatTheFileDoesNotSay)
{
    EXPECT_TRUE(Load("First\nFrameRate 60\nPosition 1 2 3\nA <---> Head 1,2,3,-1,3,2\n"));
    EXPECT_TRUE(Load("Second \n* Waist . .-1,3,2\n"));
    EXPECT_EQ(Name(), "Second");
    EXPECT_EQ(m_kEditor.GetFrameRate(), 60);
    EXPECT_EQ(m_kEditor.FieldText(kNameField), "Second");
    EXPECT_EQ(m_kEditor.FieldText(kOffsetYField), "2");
    EXPECT_EQ(m_kEditor.FieldText(kFrameRateField), "60");
    EXPECT_THAT(RowTexts(m_kEditor.Rows()),
                ElementsAre("[FIXED]|Waist|0|0|0|-X| Z| Y", kLPelvisRow, kRPelvisRow));
    EXPECT_FALSE(m_kEditor.IsDirty());
}

TEST_F(ProfileEditor, LaterRowOfATargetKeepsSourceAndFirstRowKeepsRotation)
{
    Load("N\nA x Waist 1,1,1\nA x Head 2,2,2\nB x waist 8,8,8,3,2,1\nC x HEAD 9,9,9\n");
    EXPECT_THAT(RowTexts(m_kEditor.Rows()),
                ElementsAre("A|waist|1|1|1| Z| Y| X", "A|HEAD|9|9|9|||", kLPelvisRow, kRPelvisRow));
}

TEST_F(ProfileEditor, CountersAndAnswerTellHowAFileFits)
{
    const std::tuple<const char*, const char*, const char*> rows[] = {
        {"no rows", "", "0 of 0, fits"},
        {"both found", "A x Head 0\nB x Waist 0\n", "2 of 2, fits"},
        {"names without case", "a x HEAD 0\n", "1 of 1, fits"},
        {"source missing", "A x Head 0\nNone x Waist 0\n", "1 of 2, misfit"},
        {"a bad row first", "None x Waist 0\nA x Head 0\n", "1 of 2, misfit"},
        {"target missing", "A x None 0\n", "0 of 1, fits"},
        {"both missing", "No x None 0\n", "0 of 1, fits"},
        {"fixed rows count not", "* Head . .1,2,3\n* None . .1,2,3\n", "0 of 0, fits"},
        {"a blank line repeats", "A x Head 0\n\n", "2 of 2, fits"},
        {"keywords count not", "FrameRate 60\nPosition 1 2 3\nA x Head\n", "1 of 1, fits"},
    };
    for (const auto& [what, lines, verdict] : rows)
        EXPECT_EQ(Count(MakeProfile(std::string("N\n") + lines)), verdict) << what;
    EXPECT_FALSE(m_kEditor.CountMatches(MakeProfile("N\nNone x Head 0\n"), nullptr, nullptr))
        << "no counters";
    CProfileEditorDialog noScenes(m_kOwner);
    EXPECT_TRUE(noScenes.CountMatches(MakeProfile("N\nA x Head 0\n"), nullptr, nullptr))
        << "nothing is found";
}

TEST_F(ProfileEditor, MereCountChangesNameAndPathAndNothingElse)
{
    Load("Kept\nFrameRate 60\nA x Head 5\n");
    const auto rows = RowTexts(m_kEditor.Rows());
    const std::string other = MakeProfile("Other\nFrameRate 90\nPosition 7 7 7\nB x Waist 0\n", "Other.prf");
    m_kEditor.CountMatches(other, nullptr, nullptr);
    EXPECT_EQ(Name(), "Other");
    EXPECT_EQ(m_kEditor.ProfilePath(), other);
    EXPECT_EQ(RowTexts(m_kEditor.Rows()), rows);
    EXPECT_EQ(m_kEditor.GetFrameRate(), 60);
    EXPECT_EQ(m_kEditor.FieldText(kNameField), "Kept");
    EXPECT_FALSE(m_kEditor.SourceTree().IsMapped(m_kEditor.FindSourceItem("B")));
}

TEST_F(ProfileEditor, FileThatCannotBeOpenedChangesNothing)
{
    Load("Kept\nA x Head 5\n");
    const std::string path = m_kEditor.ProfilePath();
    int total = -1;
    EXPECT_FALSE(m_kEditor.ReadProfile(path + "x", nullptr, &total, EProfileRead::Load));
    EXPECT_FALSE(m_kEditor.CountMatches(m_kOwner.ProfileFile(""), nullptr, &total)) << "a folder";
    EXPECT_EQ(total, -1);
    EXPECT_EQ(m_kEditor.ProfilePath(), path);
    EXPECT_EQ(m_kEditor.Rows().RowCount(), 3);
}

TEST_F(ProfileEditor, WrittenFileIsTheReadFileByteForByte)
{
    const std::string text =
        "My profile\nFrameRate 90\nPosition 1 -2 3\nA <---> LowerTorso 10,-20,30,-1,3,-2\n"
        "B <---> Head 0,0,0,1,2,3\n* Waist . .3,-2,1\n* LPelvis . .-1,3,2\n* RPelvis . .1,2,3\n";
    Load(text);
    EXPECT_EQ(RowText(m_kEditor.Rows(), 1), "B|Head|0|0|0|||") << "the neutral triple shows nothing";
    EXPECT_TRUE(m_kEditor.WriteProfile(EProfileWrite::Quiet));
    EXPECT_EQ(ReadText(m_kEditor.ProfilePath()), text);

    Load("N \nPosition 1.9 -2.9 nan\n* Waist . 7,8,9,1,2,-3\n");
    m_kEditor.WriteProfile(EProfileWrite::Quiet);
    EXPECT_EQ(ReadText(m_kEditor.ProfilePath()),
              "N\nFrameRate 90\nPosition 1 -2 0\n* Waist . .1,2,-3\n* LPelvis . .1,2,3\n* RPelvis . .1,2,3\n")
        << "cut toward zero; a fixed row loses its rotation";
}

TEST_F(ProfileEditor, SaveAsksBeforeItOverwritesAndFindsANewFileByItself)
{
    Load("Mine\nA x Head 0\n");
    const std::string before = ReadBytes(m_kEditor.ProfilePath());
    m_kOwner.m_eAnswer = EAnswer::Cancel;
    EXPECT_FALSE(m_kEditor.WriteProfile(EProfileWrite::Ask));
    EXPECT_EQ(ReadBytes(m_kEditor.ProfilePath()), before);
    m_kOwner.m_eAnswer = EAnswer::OK;
    EXPECT_TRUE(m_kEditor.WriteProfile(EProfileWrite::Ask));
    EXPECT_THAT(m_kOwner.TakeMessages(), ElementsAre("163", "163", "159"));

    MakeProfile("Taken\n", "Custom0.prf");
    SetField(kNameField, "Fresh");
    EXPECT_TRUE(m_kEditor.Buttons().saveProfile);
    m_kEditor.ClickButton(kSaveProfileButton);
    EXPECT_THAT(m_kOwner.TakeMessages(), ElementsAre("159"));
    EXPECT_EQ(m_kEditor.ProfilePath(), m_kOwner.ProfileFile("Custom1.prf"));
    EXPECT_EQ(ReadProfileName(m_kEditor.ProfilePath()), "Fresh");
    EXPECT_FALSE(m_kEditor.Buttons().saveProfile);
}

TEST_F(ProfileEditor, FailedSaveIsToldAndStillClearsTheFlag)
{
    Load("Mine\nA x Head 0\n");
    m_kEditor.MarkChanged();
    MakeReadOnly(m_kEditor.ProfilePath());
    const std::string before = ReadBytes(m_kEditor.ProfilePath());
    EXPECT_FALSE(m_kEditor.WriteProfile(EProfileWrite::Quiet));
    EXPECT_THAT(m_kOwner.TakeMessages(), ElementsAre("160"));
    EXPECT_FALSE(m_kEditor.IsDirty());
    EXPECT_EQ(ReadBytes(m_kEditor.ProfilePath()), before);
}

TEST_F(ProfileEditor, LoadingAsksToSaveWhatWasChanged)
{
    for (const EAnswer answer : {EAnswer::Yes, EAnswer::No})
    {
        const std::string path = MakeProfile("Mine\nFrameRate 30\nA x Head 0\n", "Mine.prf");
        m_kEditor.LoadProfile(path);
        SetField(kFrameRateField, "120");
        m_kOwner.m_eAnswer = answer;
        EXPECT_TRUE(m_kEditor.LoadProfile(m_kEditor.ProfilePath())) << "its own path is a fine argument";
        EXPECT_EQ(m_kOwner.TakeMessages().front(), "161");
        EXPECT_EQ(ReadBytes(path).find("FrameRate 120") != std::string::npos, answer == EAnswer::Yes);
        EXPECT_FALSE(m_kEditor.IsDirty());
    }
}

TEST_F(ProfileEditor, ChangeOfAReadOnlyProfileTakesANewName)
{
    // inUse: separated by bars
    const std::tuple<const char*, const char*, const char*, const char*> rows[] = {
        {"numbered", "P(1)", "x|P(1)", "P(2)"},
        {"next is taken", "A(2)", "A(2)|a(3) ", "A(4)"},
        {"case and blanks", "P", "p  ", "P(1)"},
        {"not listed", "P", "Q", "P"},
        {"word in parentheses", "P (hips)", "P (hips)", "P (hips)(1)"},
        {"last pair counts", "P(3)(4)", "P(3)(4)", "P(3)(5)"},
        {"number beyond 32 bits", "P(99999999999)", "P(99999999999)", "P(99999999999)(1)"},
    };
    for (const auto& [what, name, inUse, newName] : rows)
    {
        SCOPED_TRACE(what);
        m_kNamesInUse = SplitAtBars(inUse);
        const std::string path =
            MakeProfile(std::string(name) + "\nA x Head 0\n", std::string(what) + ".prf");
        MakeReadOnly(path);
        m_kEditor.LoadProfile(path);
        m_kEditor.MarkChanged();
        EXPECT_EQ(m_kEditor.FieldText(kNameField), newName);
        EXPECT_TRUE(m_kEditor.IsDirty());
        m_kEditor.MarkChanged();
        EXPECT_EQ(m_kEditor.FieldText(kNameField), newName) << "once is enough";
        m_kOwner.m_eAnswer = EAnswer::No;
    }
}

TEST_F(ProfileEditor, NumberedNameStaysWithinTheLimitAndCanBeSaved)
{
    const std::string longName(kProfileNameLimit + 6, 'n'); // longer than the field allows
    m_kNamesInUse = {longName};
    const std::string path = MakeProfile(longName + "\nA x Head 0\n");
    MakeReadOnly(path);
    m_kEditor.LoadProfile(path);
    m_kEditor.LeaveField();
    EXPECT_FALSE(m_kEditor.IsDirty()) << "leaving a field renames nothing";
    SelectBones("B", "Waist");
    m_kEditor.ClickButton(kAddToMapButton);
    m_kEditor.LeaveField();
    EXPECT_TRUE(m_kEditor.WriteProfile(EProfileWrite::Ask));
    EXPECT_THAT(m_kOwner.TakeMessages(), ElementsAre("159"));
    EXPECT_EQ(ReadProfileName(m_kOwner.ProfileFile("Custom0.prf")), longName.substr(0, 61) + "(1)");
    EXPECT_EQ(ReadProfileName(path), longName);
}

} // namespace gw
