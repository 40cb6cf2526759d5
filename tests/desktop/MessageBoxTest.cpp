// Message boxes: the answers of each set of buttons to mouse, keyboard and close box.

#include "CDialogAnswers.h"
#include "CMessageBox.h"

#include <QAbstractButton>
#include <QApplication>
#include <QClipboard>
#include <QLabel>
#include <QPlainTextEdit>
#include <QScreen>
#include <QTest>
#include <functional>
#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

using Act = std::function<void(QWidget&)>;

// Shows a box, acts on it, and returns its answer.
EAnswer Ask(EButtons buttons, const Act& act, const std::string& text = "Text",
            const std::string& details = {})
{
    const CDialogAnswers answers(act);
    return RunMessageBox(nullptr, "Caption", text, buttons, {{}, {}, details});
}

QAbstractButton* Button(QWidget& box, const char* name)
{
    return box.findChild<QAbstractButton*>(QLatin1String(name));
}

Act Press(const char* name)
{
    return [name](QWidget& box) { QTest::mouseClick(Button(box, name), Qt::LeftButton); };
}

Act Key(Qt::Key key)
{
    return [key](QWidget& box) { QTest::keyClick(&box, key); };
}

TEST(MessageBox, AnswersToButtonsKeysAndTheCloseBox)
{
    const Act close = [](QWidget& box) { box.close(); };
    const std::tuple<EButtons, std::vector<const char*>, std::vector<EAnswer>> rows[] = {
        {EButtons::OK, {"ok"}, {EAnswer::OK}},
        {EButtons::OKCancel, {"ok", "cancel"}, {EAnswer::OK, EAnswer::Cancel}},
        {EButtons::YesNoCancel, {"yes", "no", "cancel"}, {EAnswer::Yes, EAnswer::No, EAnswer::Cancel}},
        {EButtons::YesNo, {"yes", "no"}, {EAnswer::Yes, EAnswer::No}},
    };
    for (const auto& [buttons, names, answers] : rows)
    {
        SCOPED_TRACE(names.back());
        for (size_t i = 0; i < names.size(); ++i)
            EXPECT_EQ(Ask(buttons, Press(names[i])), answers[i]) << names[i];
        EXPECT_EQ(Ask(buttons, Key(Qt::Key_Return)), answers.front());
        EXPECT_EQ(Ask(buttons, Key(Qt::Key_Enter), "Text", "Details"), answers.front());
        EXPECT_EQ(Ask(buttons, Key(Qt::Key_Escape)), answers.back()) << "the most careful one";
        EXPECT_EQ(Ask(buttons, close), answers.back());
    }
}

// Expects that every part of a box is completely visible.
void ExpectAllInside(const QWidget& box)
{
    EXPECT_TRUE(box.screen()->availableGeometry().contains(box.geometry()));
    for (const QWidget* child : box.findChildren<QWidget*>(QString(), Qt::FindDirectChildrenOnly))
    {
        EXPECT_TRUE(!child->isVisible() || box.rect().contains(child->geometry()))
            << qPrintable(child->objectName());
    }
}

TEST(MessageBox, TextsOfFilesArePlainAndNeverCut)
{
    const std::string path = "<b>x</b> Tom & Jerry\n/" + std::string(4000, 'm');
    Ask(
        EButtons::OK,
        [&](QWidget& box) {
            const auto* label = box.findChild<QLabel*>(QStringLiteral("text"));
            EXPECT_EQ(label->textFormat(), Qt::PlainText);
            EXPECT_EQ(label->accessibleName().toStdString(), path);
            EXPECT_GE(label->height(), label->heightForWidth(label->width()));
            // All text fits: a label that cannot wrap would be wider than it is.
            EXPECT_LE(label->minimumSizeHint().width(), label->width());
            ExpectAllInside(box);
            box.close();
        },
        path);
}

TEST(MessageBox, DetailsFoldOutUnderTheTextAndScroll)
{
    std::string details;
    for (int line = 0; line < 500; ++line)
        details += "take.bvh:" + std::to_string(line) + ": a number with something stuck to it\n";
    Ask(
        EButtons::YesNo,
        [&](QWidget& box) {
            const int folded = box.height();
            auto* text = box.findChild<QPlainTextEdit*>();
            EXPECT_FALSE(text->isVisible() || Button(box, "copy")->isVisible());
            Press("details")(box);
            EXPECT_TRUE(WaitUntil([&] { return box.height() > folded + 100; }));
            EXPECT_LE(box.height(), box.screen()->availableSize().height() * 6 / 10 + 1);
            ExpectAllInside(box);
            Press("copy")(box);
            EXPECT_EQ(QApplication::clipboard()->text().toStdString(), details);
            Press("details")(box);
            EXPECT_TRUE(WaitUntil([&] { return box.height() == folded; }));
            box.close();
        },
        "Text", details);
    Ask(EButtons::OK, [](QWidget& box) {
        EXPECT_EQ(Button(box, "details"), nullptr);
        box.close();
    });
}

} // namespace
} // namespace gw
