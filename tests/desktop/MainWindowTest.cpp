#include "CPerson.h"
#include "CPreviewWidget.h"
#include "CProfileEditorDialog.h"
#include "Paths.h"
#include "QtText.h"

#include <QApplication>
#include <QComboBox>
#include <QLabel>
#include <QMenu>
#include <QMouseEvent>
#include <QSlider>
#include <QSurfaceFormat>
#include <QTest>
#include <gmock/gmock.h>
#include <sstream>
#include <tuple>

namespace gw {
namespace {

int ScrollValue(CPerson& person)
{
    return static_cast<QSlider*>(person.Child("|playbar"))->value();
}

void OpenWalk(CPerson& person)
{
    person.WillChooseFile(ExampleFile("walk.bvh"));
    person.Click("open");
}

void OpenAndConvert(CPerson& person)
{
    OpenWalk(person);
    person.Click("convert");
    ASSERT_TRUE(person.Content().IsConverted());
}

bool ShowsSomething(const QImage& picture)
{
    QImage ground = picture;
    ground.fill(picture.pixelColor(0, 0));
    return picture != ground;
}

void ChooseOption(CPerson& person, int row)
{
    person.Click("options");
    ClickInMenu(row);
    ASSERT_TRUE(WaitUntil([] { return !QApplication::activePopupWidget(); }));
}

// Writes the example motion with meaningless names.
std::string NamelessWalk(const std::string& folder)
{
    std::istringstream lines(ReadBytes(ExampleFile("walk.bvh")));
    std::string text;
    int number = 0;
    for (std::string line; std::getline(lines, line);)
    {
        const size_t name = std::min(line.find("ROOT "), line.find("JOINT "));
        if (name != line.npos)
            line.replace(line.find(' ', name), line.npos,
                         std::string(" piece").append(std::to_string(number++)));
        text += line + '\n';
    }
    WriteBytes(folder + "nameless.bvh", text);
    return folder + "nameless.bvh";
}

std::string CopyTo(const std::string& folder, const char* example, const char* name)
{
    WriteBytes(folder + name, ReadBytes(ExampleFile(example)));
    return folder + name;
}

} // namespace

TEST(MainWindow, AMotionIsOpenedConvertedPlayedAndSaved)
{
    CPerson person;
    EXPECT_FALSE(person.IsOn("convert"));
    EXPECT_FALSE(ShowsSomething(person.Picture("#cnt1")));
    OpenWalk(person);
    EXPECT_TRUE(ShowsSomething(person.Picture("#cnt1")));
    EXPECT_FALSE(ShowsSomething(person.Picture("#cnt2")));
    EXPECT_FALSE(person.IsOn("apply"));

    person.Type(Qt::Key_Return, Qt::ControlModifier);
    ASSERT_TRUE(person.IsOn("apply"));
    const QImage first = person.Picture("#cnt2");
    EXPECT_TRUE(ShowsSomething(first));

    person.Type(Qt::Key_Space);
    EXPECT_TRUE(WaitUntil([&] { return ScrollValue(person) > 40; }));
    person.Type(Qt::Key_Space);
    EXPECT_NE(person.Picture("#cnt2"), first);
    const int paused = ScrollValue(person);
    person.Wait(60);
    EXPECT_EQ(ScrollValue(person), paused);
    person.Type(Qt::Key_End);
    EXPECT_EQ(ScrollValue(person), 256);
    EXPECT_EQ(person.Place(), QStringLiteral("frame 66 of 66   2.20 s"));
    person.Type(Qt::Key_Left);
    EXPECT_TRUE(person.Place().startsWith(QStringLiteral("frame 65 of 66")));

    const std::string saved = person.Home().Path("walk.Kinetra");
    person.WillChooseFile(person.Home().Path("walk")); // the dialog adds the extension
    person.WillAnswer("cancel");
    person.Type(Qt::Key_S, Qt::ControlModifier);
    EXPECT_TRUE(FileExists(saved));
    EXPECT_EQ(person.Title(), QStringLiteral("Gaitwright v2.0"));
}

TEST(MainWindow, TheBarHoldsTheClockWhileItIsDragged)
{
    CPerson person;
    OpenWalk(person);
    auto* const bar = person.Child("|playbar");
    const QPoint middle(bar->width() / 2, bar->height() / 2);
    person.Click("play");
    QTest::mousePress(bar, Qt::LeftButton, Qt::NoModifier, middle);
    EXPECT_EQ(ScrollValue(person), 128);
    person.Wait(80);
    EXPECT_EQ(ScrollValue(person), 128);
    QTest::mouseRelease(bar, Qt::LeftButton, Qt::NoModifier, middle);
    EXPECT_TRUE(WaitUntil([&] { return ScrollValue(person) > 140; })) << "plays on";
    EXPECT_TRUE(WaitUntil([&] { return ScrollValue(person) == 0; })) << "and stops at the start";
}

TEST(MainWindow, AResultThatIsNotSavedIsAskedFor)
{
    CPerson person;
    OpenAndConvert(person);
    person.WillAnswer("cancel");
    person.Type(Qt::Key_O, Qt::ControlModifier);
    EXPECT_TRUE(person.Content().IsConverted());

    person.WillAnswer("cancel");
    person.Click("exit");
    EXPECT_TRUE(WaitUntil([&] { return person.m_kBoxes.size() == 2; }));
    EXPECT_TRUE(person.Frame().isVisible());

    person.WillAnswer("no");
    person.Click("close");
    EXPECT_TRUE(WaitUntil([&] { return !person.Frame().isVisible(); }));
    EXPECT_EQ(person.m_kBoxes, QStringList(3, QStringLiteral("Save convertion result?")));
}

TEST(MainWindow, NotesStayUntilTheNextStepAndInTheirOwnBoxes)
{
    CPerson person;
    const std::string folder = person.Content().ProfileFile({});
    WriteBytes(folder + "Custom0.prf", "Mine\nhip <---> LowerTorso 0\n");
    OpenWalk(person);
    EXPECT_FALSE(person.Child("notes")->isVisible());
    person.ChooseProfile(QStringLiteral("Max BVH"));
    person.WillAnswer("ok");
    person.Click("convert");
    const QString notes = person.m_kDetails;
    person.Drop(folder + "Custom0.prf");
    person.WillAnswer("cancel");
    person.Click("del");
    EXPECT_EQ(person.m_kDetails, QString()) << "not a matter of the profile's removal";
    for (int time = 0; time < 2; ++time)
    {
        person.WillAnswer("ok");
        person.Click("notes");
        EXPECT_EQ(person.m_kBoxes.back(), QStringLiteral("Warnings from the last step"));
        EXPECT_EQ(person.m_kDetails, notes);
        EXPECT_TRUE(person.m_bUnfolded);
    }
    OpenWalk(person);
    EXPECT_FALSE(person.Child("notes")->isVisible());
}

TEST(MainWindow, LeftCtrlOnOpenConvertsAFolder)
{
    CPerson person;
    const std::string folder = person.Home().Path("takes/");
    CreateFolder(folder);
    CopyTo(folder, "walk.bvh", "a.BVH");
    CopyTo(folder, "walk.bvh", "b.bvh");
    person.ChooseProfile(QStringLiteral("Poser BVH"));
    person.Click("%adv");
    auto* const editor = person.Frame().findChild<QWidget*>(QStringLiteral("profileEditor"));
    Activate(*editor);
    const std::tuple<const char*, QWidget*> rows[] = {
        {"over the main window", &person.Frame()},
        {"over the editor, which the click leaves", editor},
        {"while another program had the keyboard", nullptr},
    };
    for (const auto& [what, pressedOver] : rows)
    {
        SCOPED_TRACE(what);
        Activate(pressedOver ? *pressedOver : *editor);
        person.m_kBoxes.clear();
        person.WillChooseFolder(folder, 1);
        person.WillAnswer("ok");
        person.PressLeft(EKey::LeftCtrl, pressedOver);
        person.ClickSlowly("open");
        person.ReleaseLeft(EKey::LeftCtrl, &person.Frame());
        EXPECT_EQ(person.m_kBoxes, QStringList{QStringLiteral("2 BVH files are successful convert to HTR.")});
    }
    EXPECT_TRUE(FileExists(folder + "a.htr") && FileExists(folder + "b.htr"));

    // A key release sent to another program leaves no key pressed.
    person.PressLeft(EKey::LeftCtrl, &person.Frame());
    person.ReleaseLeft(EKey::LeftCtrl, nullptr);
    person.WillChooseFile({});
    person.ClickSlowly("open");
}

TEST(MainWindow, RightKeysAreNotLeftKeys)
{
    CPerson person;
    QKeyEvent right(QEvent::KeyPress, Qt::Key_Control, Qt::ControlModifier, 0, 0xffe4, 0);
    QApplication::sendEvent(&person.Frame(), &right);
    OpenWalk(person); // a batch would have asked for a folder
    EXPECT_TRUE(person.Content().SourceRoot());
}

TEST(MainWindow, WhatIsDroppedOrRecentOpens)
{
    CPerson person;
    person.Drop(ExampleFile("wave.bvh"));
    person.Drop(ExampleFile("walk.bvh"));
    EXPECT_TRUE(person.IsOn("convert"));
    EXPECT_EQ(person.Content().RecentFiles().size(), 2u);
    person.Restart();
    QTest::mousePress(person.Child("face"), Qt::LeftButton, Qt::NoModifier, QPoint(3, 3));
    ClickInMenu(1);
    EXPECT_TRUE(WaitUntil([&] { return person.IsOn("convert"); }));

    const std::string broken = person.Home().Path("broken.bvh");
    WriteBytes(broken, "HIERARCHY\nnothing");
    person.WillAnswer("ok");
    person.Drop(broken);
    EXPECT_EQ(person.m_kBoxes, QStringList{QStringLiteral("Invalid BVH file format.")});
    EXPECT_THAT(ToUtf8(person.m_kDetails), testing::HasSubstr("broken.bvh:2:"));
    EXPECT_TRUE(person.IsOn("convert")) << "the source before stays";
}

TEST(MainWindow, OptionsAreOffUntilChosenAndShowWhenTheyAreOn)
{
    CPerson person;
    const auto shown = [&] { return person.Child("options")->toolTip(); };
    const QString none = shown();
    ChooseOption(person, 1);
    EXPECT_TRUE(person.Content().Choices().faithful);
    EXPECT_FALSE(person.Content().Choices().align);
    EXPECT_EQ(shown(), none + QStringLiteral(": faithful"));
    ChooseOption(person, 0);
    EXPECT_EQ(shown(), none + QStringLiteral(": aligned, faithful"));
    ChooseOption(person, 2);
    EXPECT_EQ(shown(), none + QStringLiteral(": aligned, faithful (hands free)"));
    ChooseOption(person, 1);
    EXPECT_EQ(shown(), none + QStringLiteral(": aligned"));
    person.Restart();
    EXPECT_EQ(shown(), none);
}

TEST(MainWindow, ABoneMapIsDraftedForASourceThatNoneFits)
{
    constexpr int kDraft = 4; // after the separator
    CPerson person;
    person.Drop(NamelessWalk(person.Home().Path()));
    person.Click("convert");
    EXPECT_FALSE(person.Content().IsConverted());
    ChooseOption(person, kDraft);
    ASSERT_TRUE(WaitUntil([&] { return person.Content().ProfileEditor()->IsVisible(); }));
    EXPECT_EQ(static_cast<QComboBox*>(person.Child("#format"))->currentText(), QStringLiteral("nameless"));
    person.Click("convert");
    EXPECT_TRUE(person.Content().IsConverted());
    ChooseOption(person, kDraft);
    EXPECT_EQ(static_cast<QComboBox*>(person.Child("#format"))->currentText(), QStringLiteral("nameless 2"));
}

TEST(MainWindow, ASecondClickOnTheCornerCloses)
{
    CPerson person;
    auto* const face = person.Child("face");
    QTest::mousePress(face, Qt::LeftButton, Qt::NoModifier, QPoint(3, 3));
    QMenu* const menu = OpenMenu();
    ASSERT_TRUE(menu);
    const QPoint corner = face->mapToGlobal(QPoint(3, 3));
    QMouseEvent again(QEvent::MouseButtonPress, QPointF(), corner, Qt::LeftButton, Qt::LeftButton,
                      Qt::NoModifier);
    QApplication::sendEvent(menu, &again);
    EXPECT_TRUE(WaitUntil([&] { return !person.Frame().isVisible(); }));
}

TEST(MainWindow, StandsWhereItWasClosedUnlessThatIsOffTheScreen)
{
    CPerson person;
    auto* const title = person.Child("#title");
    const QPoint before = person.Frame().pos();
    QTest::mousePress(title, Qt::LeftButton, Qt::NoModifier, QPoint(50, 10));
    QTest::mouseMove(title, QPoint(90, 35));
    QTest::mouseMove(title, QPoint(90, 35));
    QTest::mouseRelease(&person.Frame(), Qt::LeftButton, Qt::NoModifier, QPoint(50, 10));
    const QPoint moved = person.Frame().pos();
    EXPECT_NE(moved, before);
    person.Restart();
    EXPECT_EQ(person.Frame().pos(), moved);
    EXPECT_EQ(person.Frame().size(), person.Child("face")->size());
    person.Frame().move(5000, 5000);
    person.Restart();
    EXPECT_LT(person.Frame().x(), 1280);
}

TEST(PreviewWidget, SaysThatItsPixelFormatIsMissing)
{
    const QSurfaceFormat usual = QSurfaceFormat::defaultFormat();
    QSurfaceFormat unknown = usual;
    unknown.setRenderableType(QSurfaceFormat::OpenVG);
    QSurfaceFormat::setDefaultFormat(unknown);
    const CDialogAnswers answers([](QWidget& box) {
        EXPECT_EQ(box.windowTitle(), QStringLiteral("Error"));
        EXPECT_EQ(box.findChild<QLabel*>(QStringLiteral("text"))->accessibleName(),
                  QStringLiteral("ChoosePixelFormat failed"));
        box.close();
    });
    const CLeftKeys keys;
    CPreviewWidget(keys, nullptr).MakeView();
    QSurfaceFormat::setDefaultFormat(usual);
    EXPECT_FALSE(QApplication::activeModalWidget());
}

TEST(MainWindow, EveryChildHasANameAndFitsItsText)
{
    CPerson person;
    OpenAndConvert(person);
    EXPECT_EQ(person.Child("#format")->font().family(), QStringLiteral("Arial"));
    for (const QWidget* child :
         person.Child("face")->findChildren<QWidget*>(QString(), Qt::FindDirectChildrenOnly))
    {
        SCOPED_TRACE(ToUtf8(child->objectName()));
        EXPECT_TRUE(person.Child("face")->rect().contains(child->geometry()));
        const QString kind = child->property("kind").toString();
        EXPECT_TRUE(!(child->focusPolicy() & Qt::TabFocus) || !child->accessibleName().isEmpty());
        EXPECT_TRUE(kind == QStringLiteral("text") || kind == QStringLiteral("view") ||
                    child->minimumSizeHint().width() <= child->width());
    }
}

} // namespace gw
