// Undo and redo in the editor's model: the visible state after going back and forth.
#include "ProfileFixture.h"

#include <gmock/gmock.h>
#include <tuple>

namespace gw {

namespace {

class ProfileUndo : public ProfileEditor
{
protected:
    void Rename(const char* name) { SetField(kNameField, name); }
    void SetRate(const char* rate) { SetField(kFrameRateField, rate); }
    void Remove(int row)
    {
        m_kEditor.SelectOnlyRow(row);
        m_kEditor.ClickRow(row);
        m_kEditor.ClickButton(kRemoveButton);
    }
    void Add(const char* source, const char* target)
    {
        SelectBones(source, target);
        m_kEditor.ClickButton(kAddToMapButton);
    }
    /// Returns name, rate, rows and unsaved mark: "N 30 A-Waist B-Head *".
    std::string Seen() const
    {
        std::string text = Name() + ' ' + std::to_string(m_kEditor.GetFrameRate());
        const CMapRowTable& rows = m_kEditor.Rows();
        for (int row = 0; row < rows.RowCount(); ++row)
        {
            if (!rows.IsFixed(row))
                text += ' ' + rows.Text(row, kSourceColumn) + '-' + rows.Text(row, kTargetColumn);
        }
        return text + (m_kEditor.IsDirty() ? " *" : "");
    }
    /// Returns the mapped bones of both trees, as "A B | Waist".
    std::string Marked() const
    {
        const auto marked = [](const CBoneTree& tree) {
            std::string names;
            for (const CBoneTree::Item& item : tree.Items())
                names += item.m_bMapped ? item.m_kText + ' ' : "";
            return names;
        };
        return marked(m_kEditor.SourceTree()) + "| " + marked(m_kEditor.TargetTree());
    }
};

} // namespace

TEST_F(ProfileUndo, EveryCommandIsTakenBackAndRepeated)
{
    m_kOwner.boneOffset = [](CBoneOffsetDialog& dialog) {
        dialog.ChooseAxis(0, 5);
        return true;
    };
    const std::tuple<const char*, std::function<void()>, const char*> rows[] = {
        {"add", [this] { Add("C", "LowerTorso"); }, "N 30 A-Waist B-Head C-LowerTorso *"},
        {"remove", [this] { Remove(0); }, "N 30 B-Head *"},
        {"remove all", [this] { m_kEditor.ClickButton(kRemoveAllButton); }, "N 30"},
        {"rename", [this] { Rename("M"); }, "M 30 A-Waist B-Head *"},
        {"rate", [this] { SetRate("60"); }, "N 60 A-Waist B-Head *"},
        {"offset",
         [this] {
             m_kEditor.SelectOnlyRow(1);
             m_kEditor.DoubleClickRow(1);
         },
         "N 30 A-Waist B-Head *"},
    };
    for (const auto& [what, command, after] : rows)
    {
        SCOPED_TRACE(what);
        Load("N\nFrameRate 30\nA x Waist 1,2,3\nB x Head 4,5,6\n");
        const auto texts = RowTexts(m_kEditor.Rows());
        const std::string marked = Marked();
        command();
        const std::string markedAfter = Marked();
        const auto changed = RowTexts(m_kEditor.Rows());
        EXPECT_EQ(Seen(), after);
        m_kEditor.Undo();
        EXPECT_EQ(Seen(), "N 30 A-Waist B-Head") << "as it was loaded";
        EXPECT_EQ(RowTexts(m_kEditor.Rows()), texts);
        EXPECT_EQ(Marked(), marked);
        EXPECT_EQ(m_kEditor.FieldText(kNameField), "N");
        m_kEditor.Redo();
        EXPECT_EQ(Seen(), after);
        EXPECT_EQ(RowTexts(m_kEditor.Rows()), changed);
        EXPECT_EQ(Marked(), markedAfter);
        m_kEditor.PromptSaveChanges();
    }
}

TEST_F(ProfileUndo, ANewCommandEndsTheRedo)
{
    Load("N\nFrameRate 30\n");
    SetRate("60");
    m_kEditor.Undo();
    Rename("M");
    m_kEditor.Redo();
    EXPECT_EQ(Seen(), "M 30 *");
    m_kEditor.Undo();
    m_kEditor.Undo();
    EXPECT_EQ(Seen(), "N 30") << "the first step of all is the last one back";
}

TEST_F(ProfileUndo, CommandsWithoutAChangeAreNoSteps)
{
    Load("N\nFrameRate 30\nA x Waist 0\n");
    SetRate("60");
    m_kEditor.LeaveField();
    Rename("  ");
    m_kEditor.SelectOnlyRow(0);
    m_kEditor.ClickRow(0);
    m_kEditor.ClickButton(kBoneOffsetButton); // canceled
    m_kOwner.boneOffset = [](CBoneOffsetDialog&) { return true; };
    m_kEditor.ClickButton(kBoneOffsetButton); // with equal numbers
    m_kEditor.Undo();
    EXPECT_EQ(Seen(), "N 30 A-Waist");
}

TEST_F(ProfileUndo, LoadingEndsAllSteps)
{
    Load("N\nFrameRate 30\n");
    SetRate("60");
    m_kEditor.LoadProfile(MakeProfile("M\nFrameRate 90\n", "Other.prf"));
    m_kEditor.Undo();
    EXPECT_EQ(Seen(), "M 90");
}

TEST_F(ProfileUndo, AStockProfilesStepsKeepTheirNamesUntilTheSave)
{
    const std::string stock = MakeProfile("N\nFrameRate 30\nA x Waist 0\n", "Stock.prf");
    MakeReadOnly(stock);
    m_kNamesInUse = {"N"};
    m_kEditor.LoadProfile(stock);
    Add("B", "Head");
    EXPECT_EQ(Seen(), "N(1) 30 A-Waist B-Head *");
    m_kEditor.Undo();
    EXPECT_EQ(Seen(), "N 30 A-Waist");
    m_kEditor.Redo();
    m_kEditor.WriteProfile(EProfileWrite::Quiet);
    EXPECT_EQ(Seen(), "N(1) 30 A-Waist B-Head");

    m_kEditor.Undo();
    EXPECT_EQ(Seen(), "N(1) 30 A-Waist *") << "differs from the new file, and must not go to the stock one";
    m_kEditor.WriteProfile(EProfileWrite::Quiet);
    EXPECT_EQ(ReadBytes(stock), "N\nFrameRate 30\nA x Waist 0\n");
    m_kEditor.Redo();
    EXPECT_EQ(Seen(), "N(1) 30 A-Waist B-Head *");
}

TEST_F(ProfileUndo, ASavedRenameIsNoStepAnyMore)
{
    Load("N\nFrameRate 30\n");
    SetRate("60");
    Rename("M");
    m_kEditor.WriteProfile(EProfileWrite::Quiet);
    m_kEditor.Undo();
    EXPECT_EQ(Seen(), "M 30 *") << "one undo, one change to be seen";
}

TEST_F(ProfileUndo, TheOldestStepsAreForgotten)
{
    Load("N\nFrameRate 30\n");
    const int steps = static_cast<int>(CProfileHistory::kStepLimit) + 5;
    for (int step = 1; step <= steps; ++step)
        SetRate(std::to_string(30 + step).c_str());
    for (int step = 0; step < steps; ++step)
        m_kEditor.Undo();
    EXPECT_EQ(m_kEditor.GetFrameRate(), 35);
}

} // namespace gw
