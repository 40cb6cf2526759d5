#include "CPerson.h"

#include "Paths.h"
#include "QtText.h"
#include "Widgets.h"

#include <QApplication>
#include <QComboBox>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QOpenGLWidget>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QTest>
#include <gtest/gtest.h>

namespace gw {
namespace {

constexpr int kHumanClick = 120; // milliseconds

Qt::KeyboardModifier ModifierOf(EKey key)
{
    return key == EKey::LeftCtrl ? Qt::ControlModifier : Qt::ShiftModifier;
}

QKeyEvent KeyEvent(QEvent::Type type, EKey key)
{
    const bool isCtrl = key == EKey::LeftCtrl;
    return {type,
            isCtrl ? Qt::Key_Control : Qt::Key_Shift,
            type == QEvent::KeyPress ? ModifierOf(key) : Qt::NoModifier,
            0,
            static_cast<quint32>(isCtrl ? 0xffe3 : 0xffe1),
            0};
}

} // namespace

CTempHome::CTempHome()
{
    for (const char* name : {"HOME", "XDG_CONFIG_HOME", "XDG_CONFIG_DIRS", "XDG_RUNTIME_DIR"})
        qputenv(name, m_kFolder.Path().c_str());
}

CPerson::CPerson()
{
    std::string problem;
    EXPECT_TRUE(m_kSkin.Load(ExecutableFolder() + "Content", problem)) << problem;
    qApp->setStyleSheet(m_kSkin.StyleSheet());
    Start();
}

// Queued events run while everything still exists.
CPerson::~CPerson()
{
    Wait(0);
}

void CPerson::Start()
{
    m_spPlatform = std::make_unique<CSystemPlatform>(EPlatformWriting::Yes);
    m_spFrame = std::make_unique<CGaitConvertFrame>(m_kSkin, m_kKeys, *m_spPlatform);
    m_spFrame->show();
    Activate(*m_spFrame);
}

void CPerson::Restart()
{
    m_spFrame->close();
    m_spFrame.reset();
    Start();
}

QWidget* CPerson::Child(const char* name)
{
    return &ChildOf(*m_spFrame, QString::fromLatin1(name));
}

bool CPerson::IsOn(const char* name)
{
    return Child(name)->isEnabled();
}

QString CPerson::Title()
{
    return Child("#title")->toolTip();
}

QString CPerson::Place()
{
    return static_cast<QLabel*>(Child("#frame"))->text();
}

QImage CPerson::Picture(const char* view)
{
    return static_cast<QOpenGLWidget*>(Child(view))->grabFramebuffer();
}

void CPerson::Click(const char* name)
{
    QTest::mouseClick(Child(name), Qt::LeftButton);
}

void CPerson::ClickSlowly(const char* name)
{
    Qt::KeyboardModifiers modifiers;
    for (const EKey key : m_kHeld)
        modifiers |= ModifierOf(key);
    QWidget* const child = Child(name);
    QTest::mousePress(child, Qt::LeftButton, modifiers);
    Activate(*m_spFrame);
    Wait(kHumanClick);
    QTest::mouseRelease(child, Qt::LeftButton, modifiers);
}

void CPerson::PressLeft(EKey key, QWidget* window)
{
    m_kHeld.insert(key);
    QKeyEvent event = KeyEvent(QEvent::KeyPress, key);
    if (window)
        QApplication::sendEvent(window, &event);
}

void CPerson::ReleaseLeft(EKey key, QWidget* window)
{
    m_kHeld.erase(key);
    QKeyEvent event = KeyEvent(QEvent::KeyRelease, key);
    if (window)
        QApplication::sendEvent(window, &event);
}

void CPerson::Type(int key, Qt::KeyboardModifiers modifiers)
{
    Activate(*m_spFrame);
    QTest::keyClick(m_spFrame->windowHandle(), static_cast<Qt::Key>(key), modifiers);
}

void CPerson::Drop(const std::string& path)
{
    EXPECT_TRUE(DropFile(*m_spFrame, *m_spFrame, path));
    Wait(50);
}

void CPerson::ChooseProfile(const QString& name)
{
    auto* const list = static_cast<QComboBox*>(Child("#format"));
    const int index = list->findText(name);
    ASSERT_GE(index, 0) << ToUtf8(name);
    list->setCurrentIndex(index);
    emit list->activated(index);
}

void CPerson::WillAnswer(const char* button)
{
    m_kAnswers.Add([this, name = QString::fromLatin1(button)](QWidget& dialog) {
        auto* const found = dialog.findChild<QPushButton*>(name);
        if (!found)
            return false;
        m_pkAsker = dialog.parentWidget()->window();
        const auto* text = dialog.findChild<QLabel*>(QStringLiteral("text"));
        m_kBoxes << (text ? text->accessibleName() : QString());
        const auto* details = dialog.findChild<QPlainTextEdit*>(QStringLiteral("detailsText"));
        m_kDetails = details ? details->toPlainText() : QString();
        m_bUnfolded = details && details->isVisible();
        QTest::mouseClick(found, Qt::LeftButton);
        return true;
    });
}

void CPerson::WillChooseFile(const std::string& path)
{
    m_kAnswers.Add([path](QWidget& dialog) { return ChooseFile(dialog, path); });
}

void CPerson::WillChooseFolder(const std::string& folder, int filter)
{
    m_kAnswers.Add([folder, filter](QWidget& dialog) {
        auto* const edit = dialog.findChild<QLineEdit*>(QStringLiteral("102"));
        if (!edit)
            return false;
        if (auto* filters = dialog.findChild<QComboBox*>())
            filters->setCurrentIndex(filter - 1);
        edit->setText(ToQString(folder));
        QMetaObject::invokeMethod(&dialog, "accept");
        return true;
    });
}

void CPerson::Wait(int milliseconds)
{
    QTest::qWait(milliseconds);
}

std::string ExampleFile(std::string_view name)
{
    return std::string(GAITWRIGHT_EXAMPLES "/") + std::string(name);
}

} // namespace gw
