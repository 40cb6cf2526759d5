// Whole stories at the main window, from the first key to the last.

#include "CPerson.h"
#include "Paths.h"
#include "QtText.h"

#include <QApplication>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTest>
#include <QWheelEvent>
#include <gmock/gmock.h>
#include <sstream>

namespace gw {
namespace {

// Writes the example walk with each axis renamed to the next one, so that Z is up.
std::string LyingWalk(const std::string& folder)
{
    std::istringstream lines(ReadBytes(ExampleFile("walk.bvh")));
    std::string text;
    for (std::string line; std::getline(lines, line); text += line + '\n')
    {
        std::istringstream words(line);
        std::string word, x, y, z;
        words >> word >> x >> y >> z;
        if (word == "OFFSET")
            line = word + ' ' + z + ' ' + x + ' ' + y;
        for (const char* kind : {"rotation", "position"})
        {
            for (size_t at = line.find(kind); at != line.npos && word == "CHANNELS";
                 at = line.find(kind, at + 1))
                line[at - 1] = line[at - 1] == 'Z' ? 'X' : static_cast<char>(line[at - 1] + 1);
        }
    }
    WriteBytes(folder + "lying.bvh", text);
    return folder + "lying.bvh";
}

QString FocusName(CPerson& person)
{
    const QWidget* const focus = person.Frame().focusWidget();
    return focus ? focus->objectName() : QString();
}

QString HintOf(CPerson& person, const char* panel)
{
    const QWidget* const hint = person.Child(panel);
    const auto* const text = hint->findChild<QLabel*>(QStringLiteral("hintText"));
    return hint->isVisible() ? text->text() : QString();
}

} // namespace

TEST(Story, ASourceIsConvertedWithTwoKeys)
{
    CPerson person;
    EXPECT_THAT(ToUtf8(HintOf(person, "#cnt1Hint")), testing::HasSubstr("Ctrl+O"));
    person.Drop(ExampleFile("wave.bvh"));
    EXPECT_THAT(ToUtf8(HintOf(person, "#cnt2Hint")), testing::HasSubstr("Convert"));
    std::string text = ReadBytes(ExampleFile("walk.bvh"));
    for (size_t at = text.find("JOINT l"); at != text.npos; at = text.find("JOINT l", at + 1))
        text.insert(at + 6, "strange_");
    WriteBytes(person.Home().Path("other.bvh"), text);
    person.Drop(person.Home().Path("other.bvh"));
    EXPECT_THAT(ToUtf8(HintOf(person, "#cnt2Hint")), testing::HasSubstr("No map fits this skeleton"));
    person.Type(Qt::Key_M, Qt::ControlModifier);
    person.Type(Qt::Key_Return, Qt::ControlModifier);
    EXPECT_TRUE(person.Content().IsConverted());
    EXPECT_EQ(HintOf(person, "#cnt2Hint"), QString());
}

TEST(Story, ALyingSourceIsFixedFromItsNote)
{
    CPerson person;
    person.Drop(LyingWalk(person.Home().Path()));
    EXPECT_EQ(static_cast<QLabel*>(person.Child("#sourceNote"))->text(), QStringLiteral("Up axis: Z"));
    person.Type(Qt::Key_Return, Qt::ControlModifier);
    ASSERT_TRUE(person.Content().IsConverted());
    person.WillAnswer("offer");
    person.Click("notes");
    EXPECT_THAT(ToUtf8(person.m_kDetails), testing::HasSubstr("up axis is Z"));
    const auto* const made = static_cast<QLabel*>(person.Child("#resultNote"));
    EXPECT_TRUE(WaitUntil([&] { return made->text().endsWith(QStringLiteral("aligned")); }));
    EXPECT_FALSE(person.Child("notes")->isVisible());
}

TEST(Story, TheKeyboardNeverStrandsOnAButtonThatCloses)
{
    CPerson person;
    EXPECT_EQ(FocusName(person), QStringLiteral("open"));
    person.Drop(ExampleFile("wave.bvh"));
    person.Type(Qt::Key_Return, Qt::ControlModifier);
    person.Child("apply")->setFocus();
    person.WillChooseFile(person.Home().Path("walk"));
    person.WillAnswer("cancel");
    person.Type(Qt::Key_Return);
    EXPECT_EQ(FocusName(person), QStringLiteral("apply"));
    person.Drop(ExampleFile("walk.bvh"));
    person.ChooseProfile(QStringLiteral("Max BVH"));
    EXPECT_EQ(FocusName(person), QStringLiteral("#cnt1"));
    person.Child("convert")->setFocus();
    person.WillAnswer("ok");
    person.Type(Qt::Key_Return);
    EXPECT_EQ(FocusName(person), QStringLiteral("convert"));
    EXPECT_TRUE(person.Frame().isVisible());
}

TEST(Story, ABoneMapIsFoundByAPartOfItsName)
{
    CPerson person;
    auto* const field = static_cast<QComboBox*>(person.Child("#format"));
    QWheelEvent wheel({5, 5}, field->mapToGlobal(QPointF(5, 5)), {}, {0, -120}, Qt::NoButton, Qt::NoModifier,
                      Qt::NoScrollPhase, false);
    QApplication::sendEvent(field, &wheel);
    EXPECT_EQ(field->currentIndex(), -1);
    person.Click("pull");
    auto* const filter = person.Frame().findChild<QLineEdit*>(QStringLiteral("mapFilter"));
    ASSERT_TRUE(filter);
    QTest::keyClicks(filter, QStringLiteral("nothing"));
    QTest::keyClick(filter, Qt::Key_Escape);
    EXPECT_EQ(filter->text(), QString());
    QTest::keyClicks(filter, QStringLiteral("SER bv"));
    QTest::keyClick(filter, Qt::Key_Return);
    EXPECT_EQ(field->currentText(), QStringLiteral("Poser BVH"));
    EXPECT_EQ(SplitPath(person.Content().ProfilePath()).stem, "PoserBVH");
}

} // namespace gw
