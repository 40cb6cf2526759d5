// The editor's model: the effect of fields, clicks and selections.
#include "ProfileFixture.h"

#include <gmock/gmock.h>
#include <tuple>

namespace gw {

namespace {

std::string Joined(const std::vector<std::string>& messages)
{
    std::string text;
    for (const std::string& message : messages)
        text += (text.empty() ? "" : ", ") + message;
    return text;
}

} // namespace

TEST_F(ProfileEditor, NumberFieldsAreClampedWithTheirLimits)
{
    const std::tuple<const char*, int, const char*, const char*, const char*> rows[] = {
        {"rate too low", kFrameRateField, "10", "30", "157 30 240"},
        {"no number", kFrameRateField, "fast", "30", "157 30 240"},
        {"offset too low", kOffsetXField, "-10001", "-10000", "157 -10000 10000"},
        {"beyond 32 bits", kOffsetZField, "99999999999", "10000", "157 -10000 10000"},
        {"at the limit", kOffsetYField, "10000", "10000", ""},
        {"what follows counts not", kFrameRateField, "60 fps", "60", ""},
    };
    for (const auto& [what, field, text, shown, message] : rows)
    {
        CProfileEditorDialog editor(m_kOwner);
        editor.EditField(field, text);
        editor.LeaveField();
        EXPECT_EQ(editor.FieldText(field), shown) << what;
        EXPECT_EQ(editor.IsDirty(), std::string(shown) != "30") << what;
        EXPECT_EQ(Joined(m_kOwner.TakeMessages()), message) << what;
    }
}

TEST_F(ProfileEditor, RenameIsTakenOrRefusedWhole)
{
    m_kNamesInUse = {"Mine", "Stock"};
    const std::string e64 = "\xc3\xa9" + std::string(63, 'e');
    const std::string e65 = e64 + 'e';
    const std::tuple<const char*, std::string, std::string, std::string> rows[] = {
        {"free name", "New one ", "New one", ""}, {"taken name", "stock", "Mine", "158"},
        {"empty name", "  ", "Mine", "158"},      {"case alone", "MINE", "Mine", ""},
        {"cut at the limit", e65, e64, ""},
    };
    for (const auto& [what, typed, named, messages] : rows)
    {
        SCOPED_TRACE(what);
        CProfileEditorDialog editor(m_kOwner);
        editor.SetNamesInUse(&m_kNamesInUse);
        editor.LoadProfile(MakeProfile("Mine\n", "Mine.prf"));
        editor.MarkChanged(); // pending before the rename
        editor.EditField(kNameField, typed);
        editor.LeaveField();
        std::string name;
        editor.GetProfileName(name);
        EXPECT_EQ(name, named);
        EXPECT_TRUE(messages.empty() || editor.FieldText(kNameField) == "Mine")
            << "refused, and the old one shown";
        EXPECT_EQ(editor.IsDirty(), messages.empty());
        EXPECT_EQ(Joined(m_kOwner.TakeMessages()), messages);
    }
}

TEST_F(ProfileEditor, AddToMapNeedsTwoFreeBones)
{
    Load("N\nA x Waist 0\n");
    const std::tuple<const char*, const char*, const char*, bool> rows[] = {
        {"both free", "B", "Head", true},
        {"nothing selected in source", "none", "Head", false},
        {"nothing selected in target", "B", "none", false},
        {"source is mapped", "A", "Head", false},
        {"pelvis takes no source", "B", "LPelvis", false},
    };
    for (const auto& [what, source, target, addToMap] : rows)
    {
        SelectBones(source, target);
        EXPECT_EQ(m_kEditor.Buttons().addToMap, addToMap) << what;
    }
}

TEST_F(ProfileEditor, RowButtonsFollowTheSelection)
{
    m_kEditor.UpdateButtons();
    EXPECT_FALSE(m_kEditor.Buttons().removeAll);
    Load("N\nA x Waist 0\nB x Head 0\n");
    // selected: digits
    const std::tuple<const char*, const char*, bool, bool> rows[] = {
        {"none", "", false, false},
        {"one", "1", true, true},
        {"two", "01", true, false},
        {"a fixed one", "2", false, true},
        {"one among them", "03", false, false},
    };
    for (const auto& [what, selected, remove, boneOffset] : rows)
    {
        m_kEditor.SelectOnlyRow(CMapRowTable::kNone);
        for (const char digit : std::string_view(selected))
            m_kEditor.SelectRow(digit - '0', true);
        m_kEditor.UpdateButtons();
        EXPECT_EQ(m_kEditor.Buttons().remove, remove) << what;
        EXPECT_EQ(m_kEditor.Buttons().boneOffset, boneOffset) << what;
        EXPECT_TRUE(m_kEditor.Buttons().removeAll) << what;
    }
}

TEST_F(ProfileEditor, RemoveDoesNotCorrectItsIndices)
{
    m_kEditor.SetSourceScene(nullptr);
    Load("N\nA x t0 0\nA x t1 0\nA x t2 0\nA x t3 0\nA x t4 0\n");
    m_kEditor.SelectRow(0, true);
    m_kEditor.SelectRow(2, true);
    m_kEditor.UpdateButtons();
    m_kEditor.ClickButton(kRemoveButton);
    EXPECT_EQ(m_kEditor.Rows().Text(0, kTargetColumn), "t1");
    EXPECT_EQ(m_kEditor.Rows().Text(1, kTargetColumn), "t2") << "selected, and spared";
    EXPECT_TRUE(m_kEditor.Rows().IsSelected(1)) << "a selection goes with its row";
    EXPECT_EQ(m_kEditor.Rows().Text(2, kTargetColumn), "t4") << "t3 went in its place";

    m_kEditor.SelectOnlyRow(0);
    m_kEditor.SelectRow(4, true);
    m_kEditor.RemoveSelection();
    EXPECT_EQ(m_kEditor.Rows().RowCount(), 4) << "an index behind the end removes nothing";
}

TEST_F(ProfileEditor, RemovedRowsFreeTheirBones)
{
    Load("N\nA x Waist 0\nB x Head 0\n");
    m_kEditor.SelectOnlyRow(0);
    m_kEditor.ClickRow(0);
    std::string bone;
    EXPECT_TRUE(m_kEditor.GetSelectedSourceBone(bone));
    EXPECT_EQ(bone, "A");
    m_kEditor.ClickButton(kRemoveButton);
    EXPECT_TRUE(m_kEditor.IsDirty());
    EXPECT_TRUE(m_kEditor.Buttons().addToMap) << "the bones of the row are still selected";
    m_kEditor.ClickButton(kRemoveAllButton);
    EXPECT_EQ(m_kEditor.Rows().RowCount(), 0);
    EXPECT_FALSE(m_kEditor.IsDirty()) << "an emptied table needs no saving";
    EXPECT_FALSE(m_kEditor.SourceTree().IsMapped(m_kEditor.FindSourceItem("B")));
    EXPECT_FALSE(m_kEditor.Buttons().removeAll);
    m_kEditor.ClickRow(-1);
    EXPECT_FALSE(m_kEditor.GetSelectedTargetBone(bone));
    EXPECT_EQ(bone, "");
}

TEST_F(ProfileEditor, BoneOffsetChangesTheSelectedRow)
{
    Load("N\nA x Waist 1,2,3\nB x Head 4,5,6,-1,3,2\n");
    m_kOwner.boneOffset = [](CBoneOffsetDialog& dialog) {
        dialog.LeaveRotation(0, "70");
        dialog.ChooseAxis(0, 5);
        return true;
    };
    m_kEditor.SelectOnlyRow(1);
    m_kEditor.DoubleClickRow(1);
    EXPECT_EQ(RowText(m_kEditor.Rows(), 1), "B|Head|70|5|6|-Z|-X| Y");
    EXPECT_TRUE(m_kEditor.Buttons().saveProfile);

    m_kEditor.SelectOnlyRow(0);
    EXPECT_TRUE(m_kEditor.EditBoneOffset());
    EXPECT_EQ(RowText(m_kEditor.Rows(), 0), "A|Waist|1|2|3|-Z| Y| X") << "the first row keeps its rotation";
}

} // namespace gw
