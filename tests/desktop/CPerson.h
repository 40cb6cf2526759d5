#pragma once

#include "CDialogAnswers.h"
#include "CFilePlatform.h"
#include "CGaitConvertContent.h"
#include "CGaitConvertFrame.h"
#include "CLeftKeys.h"
#include "CSkin.h"
#include "TempFolder.h"

#include <QImage>
#include <QString>
#include <memory>
#include <string>

class QWidget;

namespace gw {

/// A home folder of its own: whoever is made while it lives finds settings and documents there.
class CTempHome
{
public:
    CTempHome();

    std::string Path(std::string_view name = {}) const { return m_kFolder.Path(name); }

private:
    CTempFolder m_kFolder;
};

/// A person in front of the main window, who knows it by its children's names and works with mouse and keys.
class CPerson
{
public:
    CPerson();
    ~CPerson();

    CGaitConvertFrame& Frame() { return *m_spFrame; }
    CGaitConvertContent& Content() { return m_spFrame->Content(); }
    const CTempHome& Home() const { return m_kHome; }

    /// A child of the main window, by name; a test that asks for one that is not there fails.
    QWidget* Child(const char* name);
    bool IsOn(const char* name);
    QString Title();
    QString Place();
    /// What a view shows.
    QImage Picture(const char* view);

    void Click(const char* name);
    /// Clicks as a person does: the press takes its time and activates the main window, if another one was
    /// active.
    void ClickSlowly(const char* name);
    /// Presses a left key over a window of the program; with null, another program has the keyboard.
    void PressLeft(EKey key, QWidget* window);
    void ReleaseLeft(EKey key, QWidget* window);
    void Type(int key, Qt::KeyboardModifiers modifiers = Qt::NoModifier);
    void Drop(const std::string& path);
    void ChooseProfile(const QString& name);
    /// Closes the program and starts it anew, in the same home.
    void Restart();

    // What a person does when the next window comes up, said before it does. Each window answers one.
    /// A message box: clicks the button of a name ("ok", "yes").
    void WillAnswer(const char* button);
    /// A file dialog: types a path and accepts; with an empty path cancels.
    void WillChooseFile(const std::string& path);
    /// The folder chooser: types a folder, selects a filter from 1 on, accepts.
    void WillChooseFolder(const std::string& folder, int filter);
    /// The texts of the message boxes that came up.
    QStringList m_kBoxes;
    QString m_kDetails;       ///< of the last one
    bool m_bUnfolded = false; ///< whether they could be seen at once

    void Wait(int milliseconds);

private:
    void Start();

    CTempHome m_kHome;
    std::unique_ptr<CFilePlatform> m_spPlatform;
    std::set<EKey> m_kHeld; // on the keyboard, whoever has the focus
    CLeftKeys m_kKeys{[this] { return m_kHeld; }};
    CSkin m_kSkin;
    std::unique_ptr<CGaitConvertFrame> m_spFrame;
    CDialogAnswers m_kAnswers;
};

/// The path of an example motion of the project's own.
std::string ExampleFile(std::string_view name);

} // namespace gw
