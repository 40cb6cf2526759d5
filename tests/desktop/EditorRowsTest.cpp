// A user maps bones: trees, rows and buttons of the editor's window.
#include "EditorFixture.h"

#include "BoneMarker.h"

#include <QApplication>
#include <QScrollBar>
#include <QTest>
#include <gmock/gmock.h>

namespace gw {

using testing::ElementsAre;
using testing::IsEmpty;

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
}

TEST_F(EditorRows, ControlsOfOldAreThereAndNeverSeen)
{
    for (const int id : {3, 4, int{kOffsetXField}, int{kOffsetYField}, int{kOffsetZField}})
        EXPECT_FALSE(Child<QWidget>(id).isVisible()) << id;
    for (const int id : {int{kNameField}, int{kFrameRateField}, int{kSourceTree}, int{kMapRowList}})
        EXPECT_TRUE(Child<QWidget>(id).isVisible()) << id;
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

TEST_F(EditorRows, AClickOnARowSelectsItsBones)
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

    m_kEditor.resize(m_kEditor.width(), 900); // so that there is room below the rows
    Settle();
    auto& list = Child<CMapRowView>(kMapRowList);
    QTest::mouseClick(list.viewport(), Qt::LeftButton, {},
                      list.viewport()->rect().bottomLeft() - QPoint(-5, 2));
    Settle();
    EXPECT_THAT(SelectedRows(), IsEmpty());
    EXPECT_EQ(SelectedBone(kSourceTree), "") << "no row has no bones";
}

TEST_F(EditorRows, TheKeyboardSelectsRowsAsTheMouseDoes)
{
    ClickRow(1);
    Press(Qt::Key_Down);
    EXPECT_EQ(SelectedBone(kSourceTree), "lShin");
    Press(Qt::Key_Down, Qt::ShiftModifier);
    EXPECT_THAT(SelectedRows(), ElementsAre(2, 3));
    EXPECT_FALSE(IsEnabled(kBoneOffsetButton));
}

TEST_F(EditorRows, UndoAndRedoGoThroughTheCommands)
{
    Use("hip x LowerTorso 0\nlShin x LCalf 0\n");
    const auto before = Rows();
    ClickRow(1);
    Click(kRemoveButton);
    Click(kRemoveAllButton);
    Press(Qt::Key_Z, Qt::ControlModifier);
    EXPECT_EQ(Rows().size(), 3u);
    Press(Qt::Key_Z, Qt::ControlModifier);
    EXPECT_EQ(Rows(), before);
    EXPECT_THAT(SelectedRows(), ElementsAre(1));
    EXPECT_FALSE(IsEnabled(kSaveProfileButton)) << "as the file has it";
    Press(Qt::Key_Y, Qt::ControlModifier);
    EXPECT_EQ(Rows().size(), 3u);
    Press(Qt::Key_Z, Qt::ControlModifier | Qt::ShiftModifier);
    EXPECT_THAT(Rows(), IsEmpty());
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

TEST_F(EditorRows, AnotherSourceFillsTheTreeAnew)
{
    Open(Write("run.bvh", BvhText(kMaxBones)));
    Settle();
    EXPECT_THAT(Bones(kSourceTree),
                ElementsAre("Bip01", "L_Thigh", "L_Calf", "L_Foot", "R_Thigh", "R_Calf", "R_Foot"));
    EXPECT_EQ(Field(kNameField), "3DS MAX");
}

TEST_F(EditorRows, TheListScrollsNeitherAtAClickNorAtARemoval)
{
    std::string many;
    for (int row = 0; row < 200; ++row)
        many.append("a")
            .append(std::to_string(row))
            .append(" x t")
            .append(std::to_string(row))
            .append(" 0\n");
    Use(many);
    QScrollBar& bar = *Child<CMapRowView>(kMapRowList).verticalScrollBar();
    bar.setValue(100);
    ClickRow(102);
    Click(kRemoveButton);
    EXPECT_EQ(bar.value(), 100);
    EXPECT_EQ(Rows()[102], "a103 > t103 0 0 0");
    EXPECT_EQ(Rows().size(), 201u);
}

TEST_F(EditorRows, TheFilterShowsWhatIsStillToBeMappedFirst)
{
    Use("hip x LowerTorso 0\nlThigh x LThigh 0\n");
    ClickBone(kSourceTree, "rThigh");
    Press(Qt::Key_F, Qt::ControlModifier);
    QTest::keyClicks(QApplication::focusWidget(), QStringLiteral("THIGH"));
    Settle();
    EXPECT_THAT(Bones(kSourceTree), ElementsAre("rThigh", "lThigh"));
    EXPECT_THAT(Bones(kTargetTree), ElementsAre("RThigh", "LThigh"));
    EXPECT_EQ(SelectedBone(kSourceTree), "rThigh");
    ClickBone(kTargetTree, "RThigh");
    Click(kAddToMapButton);
    EXPECT_THAT(Bones(kTargetTree), ElementsAre("LThigh", "RThigh"))
        << "mapped as well now: the tree's order";

    Press(Qt::Key_F, Qt::ControlModifier);
    Press(Qt::Key_Escape);
    EXPECT_TRUE(m_kEditor.isVisible());
    EXPECT_FALSE(Child<QWidget>(QStringLiteral("filterLine")).isVisible());
    EXPECT_EQ(Bones(kSourceTree).size(), 7u);
    EXPECT_EQ(SelectedBone(kTargetTree), "RThigh");
}

TEST_F(EditorRows, AFilteredListStaysWhileItsBonesAreMapped)
{
    std::string text = "HIERARCHY\nROOT hip\n{\nOFFSET 0 0 0\nCHANNELS 3 Zrotation Xrotation Yrotation\n";
    for (int bone = 0; bone < 100; ++bone)
        text.append("JOINT b")
            .append(std::to_string(bone))
            .append("\n{\nOFFSET 0 1 0\nCHANNELS 0\nEnd Site\n"
                    "{\nOFFSET 0 1 0\n}\n}\n");
    Open(Write("many.bvh", text + "}\nMOTION\nFrames: 1\nFrame Time: 0.03\n0 0 0\n"));
    Settle();
    ClickBone(kTargetTree, "Waist");
    Press(Qt::Key_F, Qt::ControlModifier);
    Press(Qt::Key_B);
    QScrollBar& bar = *Child<CBoneTreeView>(kSourceTree).verticalScrollBar();
    bar.setValue(40);
    ClickBone(kSourceTree, "b42");
    Click(kAddToMapButton);
    EXPECT_EQ(Rows().back(), "b42 > Waist 0 0 0");
    EXPECT_EQ(Bones(kSourceTree).back(), "b42") << "the mapped ones stand last";
    EXPECT_EQ(bar.value(), 40) << "and the next ones under the mouse";
}

TEST_F(EditorRows, ASelectionOutlivesTheFilterThatHidesIt)
{
    Use("hip x LowerTorso 0\n");
    ClickBone(kSourceTree, "lShin");
    Press(Qt::Key_F, Qt::ControlModifier);
    QTest::keyClicks(QApplication::focusWidget(), QStringLiteral("calf"));
    Settle();
    EXPECT_THAT(Bones(kSourceTree), IsEmpty());
    ClickBone(kTargetTree, "LCalf");
    EXPECT_EQ(Child<QLabel>(QStringLiteral("pair")).text(), QStringLiteral("lShin \u2192 LCalf"));
    Click(kAddToMapButton);
    EXPECT_EQ(Rows().back(), "lShin > LCalf 0 0 0");
}

TEST(BoneMarker, TellsMappedBonesSelectedOnesAndTreesApart)
{
    const auto middle = [](int image, int selected, QIcon::Mode mode) {
        return BoneMarker(image, selected).pixmap(QSize(16, 16), 1.0, mode).toImage().pixelColor(8, 8);
    };
    EXPECT_EQ(middle(0, 2, QIcon::Normal).alpha(), 0) << "hollow";
    EXPECT_EQ(middle(0, 2, QIcon::Selected).alpha(), 0);
    EXPECT_EQ(middle(1, 3, QIcon::Normal).alpha(), 255) << "filled";
    EXPECT_NE(middle(1, 3, QIcon::Normal), middle(1, 3, QIcon::Selected));
    EXPECT_NE(middle(1, 3, QIcon::Normal), middle(4, 3, QIcon::Normal)) << "source and target";
    EXPECT_TRUE(BoneMarker(5, 0).isNull());
}

} // namespace gw
