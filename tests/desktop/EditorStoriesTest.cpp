// A user works in the editor: finds bones by name, removes rows, converts and saves without leaving it.
#include "CPerson.h"
#include "EditorFixture.h"
#include "Paths.h"
#include "PlaceBeside.h"

#include <QApplication>
#include <QTest>
#include <gmock/gmock.h>

namespace gw {

using testing::ElementsAre;

namespace {

class EditorStories : public EditorTest
{
protected:
    void Search(const char* text)
    {
        Press(Qt::Key_F, Qt::ControlModifier);
        QTest::keyClicks(QApplication::focusWidget(), QString::fromUtf8(text));
        Settle();
    }
};

} // namespace

TEST_F(EditorStories, TwoBonesAreFoundByNameAndMapped)
{
    OpenEditor();
    ClickRow(5);
    Press(Qt::Key_Delete);
    EXPECT_EQ(Rows().size(), 8u);
    Search("SH");
    EXPECT_THAT(Bones(kSourceTree), ElementsAre("rShin", "lShin"))
        << "what is still to be mapped comes first";
    EXPECT_GT(Bones(kTargetTree).size(), 2u) << "each tree has its own search";
    Press(Qt::Key_Return);
    EXPECT_EQ(SelectedBone(kSourceTree), "rShin");
    EXPECT_EQ(Bones(kSourceTree).size(), 7u);
    ClickBone(kTargetTree, "Waist");
    Search("calf");
    Press(Qt::Key_Down);
    Press(Qt::Key_Return);
    EXPECT_EQ(SelectedBone(kTargetTree), "RCalf");
    Click(kAddToMapButton);
    EXPECT_EQ(Rows().back(), "rShin > RCalf 0 0 0");

    Search("nothing");
    EXPECT_TRUE(Bones(kSourceTree).empty());
    Press(Qt::Key_Return);
    EXPECT_EQ(SelectedBone(kTargetTree), "RCalf");
    Press(Qt::Key_Escape);
    EXPECT_TRUE(m_kEditor.isVisible());
    EXPECT_EQ(Bones(kSourceTree).size(), 7u);
    Press(Qt::Key_Escape);
    EXPECT_FALSE(m_kEditor.isVisible());
}

TEST_F(EditorStories, TheOffsetDialogNamesThePair)
{
    OpenEditor();
    InOffsetDialog([](QWidget& dialog) {
        EXPECT_EQ(dialog.findChild<QLabel*>(QStringLiteral("offsetPair"))->text(),
                  QStringLiteral("hip \u2192 LowerTorso"));
        EXPECT_EQ(static_cast<QLineEdit*>(dialog.focusWidget())->selectedText(), QStringLiteral("0"));
        dialog.close();
    });
    DoubleClickRow(0);
}

TEST(EditorInTheWindow, ConvertsAndSavesWithItsOwnMessages)
{
    CPerson person;
    person.Drop(ExampleFile("walk.bvh"));
    person.Click("%adv");
    auto* const editor = person.Frame().findChild<QWidget*>(QStringLiteral("profileEditor"));
    Activate(*editor);
    QTest::keyClick(editor, Qt::Key_Return, Qt::ControlModifier);
    ASSERT_TRUE(person.Content().IsConverted());
    const std::string path = person.Home().Path("walk.Kinetra");
    person.WillChooseFile(path);
    person.WillAnswer("cancel");
    QTest::keyClick(editor, Qt::Key_S, Qt::ControlModifier);
    EXPECT_TRUE(FileExists(path));
    EXPECT_EQ(person.m_pkAsker, editor);

    Activate(*editor);
    auto* const rate = editor->findChild<QLineEdit*>(QString::number(kFrameRateField));
    rate->setFocus();
    rate->selectAll();
    QTest::keyClicks(rate, QStringLiteral("5"));
    person.m_pkAsker = nullptr;
    person.WillAnswer("ok");
    person.ClickSlowly("play"); // leaves the field, which is out of range, for the main window
    EXPECT_EQ(person.m_pkAsker, editor);
}

TEST(PlaceBeside, CoversNothingIfTheScreenHasRoom)
{
    const int screen = QGuiApplication::primaryScreen()->availableGeometry().width();
    const struct
    {
        const char* what;
        int x, width, beside;
        bool apart;
    } rows[] = {
        {"room on the right", 10, screen / 3, screen / 2, true},
        {"room on the left", screen / 2, screen / 3, screen / 3, true},
        {"the other has to give way", screen / 4, screen / 2, screen / 3, true},
        {"no room", 0, screen / 2, screen, false},
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.what);
        QWidget other, window;
        other.setGeometry(row.x, 50, row.width, 100);
        window.resize(row.beside, 100);
        PlaceBeside(window, other);
        EXPECT_EQ(!window.geometry().intersects(other.geometry()), row.apart);
        EXPECT_TRUE(!row.apart || (window.x() >= 0 && window.x() + row.beside <= screen && other.x() >= 0));
    }
}

} // namespace gw
