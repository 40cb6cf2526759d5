// Sessions of a user with the map tool's window.

#include "CDialogAnswers.h"
#include "CGaitToolWindow.h"
#include "CLeftKeys.h"
#include "CPreviewWidget.h"
#include "ContentFixture.h"
#include "QtText.h"
#include "Widgets.h"

#include <QApplication>
#include <QLabel>
#include <QLineEdit>
#include <QListView>
#include <QMenu>
#include <QPushButton>
#include <QSpinBox>
#include <QTest>
#include <QTreeWidget>

namespace gw {
namespace {

class MapToolTest : public ContentTest
{
protected:
    MapToolTest()
    {
        Write("walk.bvh", BvhText(kPoserBones, 8));
        Write("map.txt",
              "Walk\nPosition 0,0,0\nFrameRate 60\nhip <---> LowerTorso .\nlThigh <---> LThigh 1,2,3\n");
        m_kTool.show();
        Activate(m_kTool);
    }

    template <class T>
    T* Child(const char* name) const
    {
        return &ChildOf<T>(m_kTool, QString::fromLatin1(name));
    }
    void Click(const char* button) const { QTest::mouseClick(Child<QPushButton>(button), Qt::LeftButton); }
    /// Clicks a button and acts in the dialog that it opens.
    template <class F>
    void ClickAnd(const char* button, F answer) const
    {
        SCOPED_TRACE(button);
        const CDialogAnswers answers([&](QWidget& dialog) { answer(dynamic_cast<QDialog&>(dialog)); });
        Click(button);
    }
    /// Clicks a button and selects a file of the temporary folder in its file dialog.
    void ClickFile(const char* button, const std::string& file) const
    {
        ClickAnd(button, [&](QDialog& dialog) { ChooseFile(dialog, m_kFolder.Path(file)); });
    }
    void LoadSourceAndMap() const
    {
        ClickFile("1000", "walk.bvh");
        ClickFile("1012", "map.txt");
    }
    QString Line(int row) const { return Child<QListView>("1008")->model()->index(row, 0).data().toString(); }
    void SelectLine(int row) const
    {
        auto* const list = Child<QListView>("1008");
        ClickItem(*list, list->model()->index(row, 0));
    }
    void SelectBone(const char* tree, const char* bone) const
    {
        auto* const view = Child<QTreeWidget>(tree);
        ClickItem(*view, ItemOf(*view, bone));
    }
    QString SelectedBone(const char* tree) const
    {
        const auto* const item = Child<QTreeWidget>(tree)->currentItem();
        return item ? item->text(0) : QString();
    }
    QString Status() const { return Child<QLabel>("status")->text(); }

    CLeftKeys m_kKeys;
    CGaitToolWindow m_kTool{m_kPlatform, m_kKeys};
};

void Press(const QWidget& dialog, const char* text)
{
    for (QPushButton* button : dialog.findChildren<QPushButton*>())
    {
        if (button->text().remove(u'&') == QLatin1String(text))
            button->click();
    }
}

} // namespace

TEST_F(MapToolTest, FromASourceToASavedResult)
{
    EXPECT_FALSE(Child<QPushButton>("1014")->isEnabled());
    EXPECT_EQ(Child<QLabel>("panel2Frame")->text(), QString());
    LoadSourceAndMap();
    EXPECT_EQ(Status(), QStringLiteral("map.txt: 5 lines"));
    EXPECT_EQ(Line(3), QStringLiteral("hip <---> LowerTorso ."));
    Click("1014");
    EXPECT_EQ(Child<QLabel>("panel2Frame")->text(), QStringLiteral("frame 0 of 7"));

    const auto picture = [this] {
        return HasOpenGL() ? Child<CPreviewWidget>("panel2View")->grabFramebuffer() : QImage();
    };
    const QImage first = picture();
    Click("1030");
    EXPECT_EQ(Child<QLabel>("panel2Frame")->text(), QStringLiteral("frame 1 of 7"));
    EXPECT_TRUE(first.isNull() || picture() != first);

    QStringList frames;
    Click("1029");
    while (m_kTool.Tool().IsPlaying())
    {
        QTest::qWait(5);
        frames << Child<QLabel>("panel2Frame")->text();
    }
    frames.removeDuplicates();
    EXPECT_GT(frames.size(), 3) << "the clock moved it";
    EXPECT_EQ(frames.last(), QStringLiteral("frame 0 of 7")) << "once, and back to the beginning";

    ClickFile("1016", "out");
    EXPECT_TRUE(Exists("out.htr")) << "with the extension that was left out";
    ClickFile("1013", "saved");
    EXPECT_EQ(Read("saved.txt"), Read("map.txt"));
}

TEST_F(MapToolTest, APairOfBonesBecomesALine)
{
    ClickFile("1000", "walk.bvh");
    SelectBone("sourceTree", "rThigh");
    SelectBone("targetTree", "RThigh");
    Click("1006");
    EXPECT_EQ(Line(3), QStringLiteral("rThigh <---> RThigh ."));
    SelectLine(3);
    EXPECT_EQ(SelectedBone("sourceTree") + SelectedBone("targetTree"), QStringLiteral("rThighRThigh"));
    Activate(m_kTool);
    QTest::keyClick(Child<QListView>("1008"), Qt::Key_Delete);
    EXPECT_EQ(Line(3), QString());
}

TEST_F(MapToolTest, EachKindOfLineHasItsDialog)
{
    const struct
    {
        int line;
        const char* dialog;
        const char* text;
    } rows[] = {
        {0, "161", "Walking"},
        {1, "159", "Position 0,-70,0"},
        {2, "160", "FrameRate -70"},
        {4, "158", "lThigh <---> LThigh 1,-70,3"},
    };
    LoadSourceAndMap();
    SelectLine(0);
    ClickAnd("1033", [&](QDialog& dialog) {
        ChildOf<QLineEdit>(dialog, QStringLiteral("text")).setText(QStringLiteral("Running"));
        Press(dialog, "Cancel");
    });
    EXPECT_EQ(Line(0), QStringLiteral("Walk"));
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.dialog);
        SelectLine(row.line);
        ClickAnd("1033", [&](QDialog& dialog) {
            EXPECT_EQ(dialog.objectName(), QLatin1String(row.dialog));
            const auto numbers = dialog.findChildren<QSpinBox*>();
            if (numbers.isEmpty())
                ChildOf<QLineEdit>(dialog, QStringLiteral("text")).setText(QLatin1String(row.text));
            else
                numbers[numbers.size() / 2]->setValue(-70);
            Press(dialog, "OK");
        });
        EXPECT_EQ(Line(row.line), QLatin1String(row.text));
        EXPECT_EQ(Child<QListView>("1008")->currentIndex().row(), row.line);
    }
}

TEST_F(MapToolTest, AMotionDroppedOnAPreviewIsLoadedThere)
{
    const auto drop = [this](const char* panel, const std::string& file) {
        QWidget* const view = Child<QWidget>(panel)->findChild<CPreviewWidget*>();
        return DropFile(view ? *view : *Child<QWidget>(panel), *Child<QWidget>(panel), m_kFolder.Path(file));
    };
    EXPECT_TRUE(drop("panel0", "walk.bvh"));
    EXPECT_EQ(Status(), QStringLiteral("walk.bvh: 8 frames"));
    EXPECT_EQ(Child<QTreeWidget>("targetTree")->topLevelItem(0)->text(0), QStringLiteral("LowerTorso"));
    EXPECT_TRUE(drop("panel1", "walk.bvh"));
    EXPECT_EQ(Child<QTreeWidget>("targetTree")->topLevelItem(0)->text(0), QStringLiteral("hip"));
    EXPECT_FALSE(drop("panel0", "map.txt"));
    EXPECT_FALSE(drop("panel2", "walk.bvh")) << "a result is no file's";
}

TEST_F(MapToolTest, TheWindowMenuOpensTheAboutBox)
{
    Click("menuButton");
    const QMenu* const menu = OpenMenu();
    ASSERT_TRUE(menu);
    const QList<QAction*> entries = menu->actions();
    ASSERT_EQ(entries.size(), 3);
    EXPECT_TRUE(entries[1]->isSeparator());
    EXPECT_EQ(entries[2]->text(), QStringLiteral("About GaitTool(&A)..."));
    QStringList words;
    const CDialogAnswers answers([&](QWidget& box) {
        for (const QLabel* label : box.findChildren<QLabel*>())
            words << label->text();
        Press(box, "OK");
    });
    ClickInMenu(2);
    EXPECT_EQ(words, (QStringList{QStringLiteral("GaitTool"), QStringLiteral("Gaitwright v2.0")}));
    Activate(m_kTool);
    QTest::keyClick(&m_kTool, Qt::Key_Escape);
    EXPECT_TRUE(m_kTool.isVisible()) << "the Escape key loses no map";
    Click("1");
    EXPECT_FALSE(m_kTool.isVisible());
}

// At the window's minimum size.
TEST_F(MapToolTest, EverythingIsNamedAndNothingIsCut)
{
    LoadSourceAndMap();
    m_kTool.resize(m_kTool.minimumSizeHint());
    QTest::qWait(0);
    for (const char* owner : {"102", "panel0", "panel1", "panel2"})
    {
        const QWidget* const widget = *owner == '1' ? &m_kTool : Child<QWidget>(owner);
        for (const QWidget* child : widget->findChildren<QWidget*>(QString(), Qt::FindDirectChildrenOnly))
            EXPECT_FALSE(child->objectName().isEmpty())
                << child->metaObject()->className() << " in " << owner;
    }
    for (const QPushButton* button : m_kTool.findChildren<QPushButton*>())
    {
        SCOPED_TRACE(ToUtf8(button->objectName()));
        EXPECT_FALSE(button->accessibleName().isEmpty());
        EXPECT_GE(button->width(), button->minimumSizeHint().width());
        EXPECT_GE(button->height(), button->minimumSizeHint().height());
        EXPECT_TRUE(m_kTool.rect().contains(
            button->mapTo(&m_kTool, QPoint(button->width(), button->height()) - QPoint(1, 1))));
    }
    for (const QLabel* label : m_kTool.findChildren<QLabel*>())
    {
        const int needed = label->wordWrap() ? 0 : label->sizeHint().width();
        EXPECT_GE(label->width(), needed) << ToUtf8(label->text());
    }
}

} // namespace gw
