// A user renames a profile, sets its rate and a row's offset, saves, and moves between fields.
#include "EditorFixture.h"

#include "CBoneOffsetWindow.h"
#include "WindowPlacement.h"

#include <QApplication>
#include <QComboBox>
#include <QFocusEvent>
#include <QScreen>
#include <QTest>
#include <gtest/gtest.h>
#include <tuple>

namespace gw {

namespace {

class EditorFields : public EditorTest
{
protected:
    EditorFields() { OpenEditor(); }
};

} // namespace

TEST_F(EditorFields, EnterCommitsARateAndKeepsTheWindow)
{
    Type(kFrameRateField, "60");
    Press(Qt::Key_Return);
    EXPECT_TRUE(m_kEditor.isVisible());
    EXPECT_EQ(QApplication::focusWidget(), &m_kEditor);
    EXPECT_EQ(Model().GetFrameRate(), 60);
    EXPECT_TRUE(IsEnabled(kSaveProfileButton));
}

TEST_F(EditorFields, ANameIsRefusedOnceItsFieldIsLeft)
{
    Type(kNameField, "mine");
    QFocusEvent menu(QEvent::FocusOut, Qt::PopupFocusReason);
    QApplication::sendEvent(&Child<QLineEdit>(kNameField), &menu);
    EXPECT_EQ(m_kWindow.TakeWords(), "");
    EXPECT_EQ(Field(kNameField), "mine") << "still being typed, under a menu";
    m_kWindow.onBox = [this] { Child<QLineEdit>(kFrameRateField).clearFocus(); };
    Child<QLineEdit>(kFrameRateField).setFocus();
    EXPECT_EQ(m_kWindow.TakeWords(), "158") << "although the message takes the focus again";
}

TEST_F(EditorFields, UndoTakesBackTypingInAFieldAndCommandsOutsideIt)
{
    Type(kFrameRateField, "60");
    Press(Qt::Key_Return);
    Type(kNameField, "Dancer");
    Press(Qt::Key_Z, Qt::ControlModifier);
    EXPECT_NE(Field(kNameField), "Dancer");
    EXPECT_EQ(Model().GetFrameRate(), 60) << "the field's own typing came first";
    Type(kNameField, "Dancer");
    Press(Qt::Key_Tab);
    Press(Qt::Key_Z, Qt::ControlModifier);
    EXPECT_EQ(Field(kNameField), "Poser") << "also from within a field that nothing was typed into";
    Press(Qt::Key_Z, Qt::ControlModifier);
    EXPECT_EQ(Field(kFrameRateField), "30");
    Press(Qt::Key_Y, Qt::ControlModifier);
    EXPECT_EQ(Field(kFrameRateField), "60");
    Press(Qt::Key_Z, Qt::ControlModifier);
    Press(Qt::Key_Z, Qt::ControlModifier | Qt::ShiftModifier);
    EXPECT_EQ(Field(kFrameRateField), "60");
}

TEST_F(EditorFields, ADoubleClickOpensARowsOffset)
{
    InOffsetDialog([](QWidget& dialog) {
        EXPECT_EQ(dialog.windowTitle(), QStringLiteral("GaitTool (Bone Offset)"));
        TypeInto(ChildOf<QLineEdit>(dialog, QStringLiteral("rotationX")), QStringLiteral("180"));
        TypeInto(ChildOf<QLineEdit>(dialog, QStringLiteral("rotationY")), QStringLiteral("180"));
        auto* const box = dialog.findChild<QComboBox*>(QStringLiteral("axisX"));
        box->setFocus();
        QTest::keyClick(box, Qt::Key_End);
        EXPECT_EQ(box->currentText(), QStringLiteral("-Z"));
        EXPECT_EQ(ChildOf<QComboBox>(dialog, QStringLiteral("axisZ")).currentText(), QStringLiteral("X"));
        EXPECT_EQ(ChildOf<QLineEdit>(dialog, QStringLiteral("rotationY")).text(), QStringLiteral("0"))
            << "only X turns by half a circle";
        QTest::mouseClick(&ChildOf(dialog, QStringLiteral("ok")), Qt::LeftButton);
    });
    DoubleClickRow(2);
    EXPECT_EQ(Rows()[2], "lShin > LCalf 180 0 0 -Z  Y  X");
    EXPECT_TRUE(IsEnabled(kSaveProfileButton));
}

TEST_F(EditorFields, EnterInTheOffsetDialogTakesTheFieldAlong)
{
    ClickRow(1);
    InOffsetDialog([](QWidget& dialog) {
        TypeInto(ChildOf<QLineEdit>(dialog, QStringLiteral("rotationZ")), QStringLiteral("-45"));
        QTest::keyClick(QApplication::focusWidget(), Qt::Key_Return);
    });
    Click(kBoneOffsetButton);
    EXPECT_EQ(Rows()[1], "lThigh > LThigh 0 0 -45");
}

TEST_F(EditorFields, EscapeCommitsAndClosesAndTheToggleComesUp)
{
    m_kWindow.m_bButtonState = true;
    Type(kFrameRateField, "60");
    const auto isKeyboardFree = [] { return !QGuiApplication::focusWindow(); };
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Escape);
    EXPECT_TRUE(WaitUntil(isKeyboardFree));
    EXPECT_FALSE(m_kEditor.isVisible());
    EXPECT_FALSE(Model().IsVisible());
    EXPECT_FALSE(m_kWindow.m_bButtonState);
    EXPECT_EQ(Model().GetFrameRate(), 60);
    Toggle(true);
    EXPECT_EQ(Field(kFrameRateField), "60") << "its state is the profile, seen or not";
    for (const int id : {kSourceTree, kMapRowList, kRemoveAllButton})
    {
        Child<QWidget>(id).setFocus();
        Press(Qt::Key_Escape);
        EXPECT_FALSE(m_kEditor.isVisible()) << id;
        EXPECT_TRUE(WaitUntil(isKeyboardFree));
        Toggle(true);
    }
}

// ---- places

class EditorPlace : public EditorTest
{
protected:
    /// Returns the stored position after the window was opened and closed.
    WindowPlacement OpenAndClose()
    {
        OpenEditor();
        Toggle(false);
        WindowPlacement placement;
        EXPECT_TRUE(ScanPlacement(m_kPlatform.ReadSetting("DialogPos"), placement));
        return placement;
    }
    QPoint OpenAt(const WindowPlacement& placement)
    {
        CProfileEditorWindow window(m_kContent, m_kPlatform, &m_kOwner);
        m_kPlatform.WriteSetting("DialogPos", PlacementText(placement));
        window.SetShown(true);
        EXPECT_TRUE(QTest::qWaitForWindowExposed(&window));
        return window.pos();
    }
};

TEST_F(EditorPlace, AWindowComesBackToWhereItWas)
{
    OpenEditor();
    m_kEditor.move(123, 45);
    m_kEditor.close();
    WindowPlacement placement;
    ASSERT_TRUE(ScanPlacement(m_kPlatform.ReadSetting("DialogPos"), placement));
    EXPECT_EQ(placement.left, 123);
    EXPECT_EQ(placement.top, 45);
    m_kEditor.windowHandle()->setPosition(300, 300); // like a window manager that positions new windows
    Toggle(true);
    EXPECT_EQ(m_kEditor.pos(), QPoint(123, 45));
    m_kEditor.move(200, 70);
    m_kEditor.SetShown(true);
    EXPECT_EQ(m_kEditor.pos(), QPoint(200, 70)) << "a visible window stays where it is";
    EXPECT_EQ(OpenAt(placement), QPoint(123, 45));
}

TEST_F(EditorPlace, APlaceOfAnotherSizeOrOffTheScreensIsNotUsed)
{
    const WindowPlacement usual = OpenAndClose();
    const std::tuple<const char*, int, int, int, int, bool> rows[] = {
        {"elsewhere on the screen", 200, 100, 0, 0, true},
        {"wider", 200, 100, 1, 0, false},
        {"lower", 200, 100, 0, -1, false},
        {"far away", 90'000, 100, 0, 0, false},
        {"above all screens", 200, -90'000, 0, 0, false},
    };
    for (const auto& [what, left, top, width, height, used] : rows)
    {
        WindowPlacement placement;
        placement.left = left;
        placement.top = top;
        placement.right = left + usual.right - usual.left + width;
        placement.bottom = top + usual.bottom - usual.top + height;
        EXPECT_EQ(OpenAt(placement) == QPoint(left, top), used) << what;
    }
    m_kPlatform.WriteSetting("DialogPos", "0,1,-1,-1,-1,-1,200,100,2147483647");
    CProfileEditorWindow window(m_kContent, m_kPlatform, &m_kOwner);
    window.SetShown(true);
    EXPECT_NE(window.pos(), QPoint(200, 100)) << "nine numbers are none";
}

} // namespace gw
