// A user maps bones: trees, rows and buttons of the editor's window.
#include "EditorFixture.h"

#include <QApplication>
#include <QScrollBar>
#include <QTest>
#include <gmock/gmock.h>

namespace gw {

using testing::ElementsAre;

namespace {

constexpr const char* kHipRow = "hip > LowerTorso 0 0 0";
constexpr const char* kPelvisRows[] = {"[FIXED] > LPelvis 0 0 0", "[FIXED] > RPelvis 0 0 0"};

class EditorRows : public EditorTest
{
protected:
    EditorRows() { OpenEditor(); }

    /// Loads a profile with these rows.
    void Use(const std::string& rows)
    {
        Click(kRemoveAllButton);
        m_kContent.UseProfileFile(Write("docs/BVH Profile/Test.prf", "Test\nFrameRate 30\n" + rows));
        Settle();
    }
};

} // namespace

TEST_F(EditorRows, TheOpenProfileStandsInTheWindow)
{
    EXPECT_EQ(Field(kNameField), "Poser");
    EXPECT_EQ(Field(kFrameRateField), "30");
    ASSERT_EQ(Rows().size(), 9u);
    EXPECT_EQ(Rows().front(), kHipRow);
    EXPECT_THAT(Bones(kSourceTree),
                ElementsAre("hip", "lThigh", "lShin", "lFoot", "rThigh", "rShin", "rFoot"));
    EXPECT_TRUE(IsEnabled(kRemoveAllButton));
    for (const int button : {kAddToMapButton, kRemoveButton, kBoneOffsetButton, kSaveProfileButton})
        EXPECT_FALSE(IsEnabled(button)) << button;
    // Controls of old are there and never seen.
    for (const int id : {3, 4, int{kOffsetXField}, int{kOffsetYField}, int{kOffsetZField}})
        EXPECT_FALSE(Child<QWidget>(id).isVisible()) << id;
}

TEST_F(EditorRows, TwoSelectedBonesAreMapped)
{
    Use("hip x LowerTorso 0\n");
    ClickBone(kSourceTree, "lShin");
    EXPECT_FALSE(IsEnabled(kAddToMapButton));
    ClickBone(kTargetTree, "LCalf");
    EXPECT_EQ(Child<QLabel>(QStringLiteral("pair")).text(), QStringLiteral("lShin \u2192 LCalf"));
    Click(kAddToMapButton);
    EXPECT_THAT(Rows(), ElementsAre(kHipRow, kPelvisRows[0], kPelvisRows[1], "lShin > LCalf 0 0 0"));
    EXPECT_FALSE(IsEnabled(kAddToMapButton)) << "both are mapped now";
    EXPECT_TRUE(IsEnabled(kSaveProfileButton));
    EXPECT_TRUE(m_kEditor.isWindowModified());
}

TEST_F(EditorRows, MouseAndKeyboardSelectRowsWithTheirBones)
{
    ClickRow(2);
    EXPECT_EQ(SelectedBone(kSourceTree), "lShin");
    EXPECT_EQ(SelectedBone(kTargetTree), "LCalf");
    EXPECT_TRUE(IsEnabled(kBoneOffsetButton));
    ClickRow(3, Qt::ControlModifier);
    EXPECT_THAT(SelectedRows(), ElementsAre(2, 3));
    EXPECT_EQ(SelectedBone(kSourceTree), "lFoot");
    EXPECT_FALSE(IsEnabled(kBoneOffsetButton)) << "it edits one row at a time";
    EXPECT_TRUE(IsEnabled(kRemoveButton));
    ClickRow(7, Qt::ControlModifier);
    EXPECT_FALSE(IsEnabled(kRemoveButton)) << "a fixed row stays";

    ClickRow(1);
    Press(Qt::Key_Down);
    EXPECT_EQ(SelectedBone(kSourceTree), "lShin");
    Press(Qt::Key_Down, Qt::ShiftModifier);
    EXPECT_THAT(SelectedRows(), ElementsAre(2, 3));
}

TEST_F(EditorRows, TreesStayAsTheyAreWhileOnlyMarkersChange)
{
    Use("hip x LowerTorso 0\nlShin x LCalf 0\n");
    auto& tree = Child<CBoneTreeView>(kSourceTree);
    const QTreeWidgetItem* const hip = tree.topLevelItem(0);
    hip->child(1)->setExpanded(false);
    const auto folded = Bones(kSourceTree);
    EXPECT_THAT(folded, ElementsAre("hip", "lThigh", "lShin", "lFoot", "rThigh"));
    const qint64 mapped = tree.topLevelItem(0)->child(0)->child(0)->icon(0).cacheKey();
    ClickRow(1);
    Click(kRemoveButton);
    EXPECT_EQ(tree.topLevelItem(0), hip) << "not built anew";
    EXPECT_EQ(Bones(kSourceTree), folded);
    EXPECT_NE(tree.topLevelItem(0)->child(0)->child(0)->icon(0).cacheKey(), mapped);

    Press(Qt::Key_F, Qt::ControlModifier);
    Press(Qt::Key_S);
    Press(Qt::Key_Escape);
    EXPECT_EQ(Bones(kSourceTree), folded) << "also behind a filter";
}

TEST_F(EditorRows, TheListScrollsNeitherAtAClickNorAtARemoval)
{
    std::string many;
    for (int row = 0; row < 200; ++row)
    {
        const std::string number = std::to_string(row);
        many.append("a").append(number).append(" x t").append(number).append(" 0\n");
    }
    Use(many);
    QScrollBar& bar = *Child<CMapRowView>(kMapRowList).verticalScrollBar();
    bar.setValue(100);
    ClickRow(102);
    Click(kRemoveButton);
    EXPECT_EQ(bar.value(), 100);
    EXPECT_EQ(Rows()[102], "a103 > t103 0 0 0");
    EXPECT_EQ(Rows().size(), 201u);
}

} // namespace gw
