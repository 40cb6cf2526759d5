#pragma once

#include "CDialogAnswers.h"
#include "CGaitConvertContent.h"
#include "CGaitConvertFrame.h"
#include "CLeftKeys.h"
#include "CSkin.h"
#include "CSystemPlatform.h"
#include "TempFolder.h"

#include <QImage>
#include <QPointer>
#include <QString>
#include <QWidget>
#include <memory>
#include <string>

namespace gw {

/// A temporary home folder: objects created while it exists find settings and documents there.
class CTempHome
{
public:
    CTempHome();

    std::string Path(std::string_view name = {}) const { return m_kFolder.Path(name); }

private:
    CTempFolder m_kFolder;
};

/// A user of the main window, who finds its children by name and works with mouse and keys.
class CPerson
{
public:
    CPerson();
    ~CPerson();

    CGaitConvertFrame& Frame() { return *m_spFrame; }
    CGaitConvertContent& Content() { return m_spFrame->Content(); }
    const CTempHome& Home() const { return m_kHome; }

    /// Returns a child of the main window by name; fails the test if it does not exist.
    QWidget* Child(const char* name);
    bool IsOn(const char* name);
    QString Title();
    QString Place();
    /// Returns the picture of a view.
    QImage Picture(const char* view);

    void Click(const char* name);
    /// Clicks like a person: the press takes time and activates the main window if another one was active.
    void ClickSlowly(const char* name);
    /// Presses a left key over a window of the program; with null, while another program has the keyboard.
    void PressLeft(EKey key, QWidget* window);
    void ReleaseLeft(EKey key, QWidget* window);
    void Type(int key, Qt::KeyboardModifiers modifiers = Qt::NoModifier);
    void Drop(const std::string& path);
    void ChooseProfile(const QString& name);
    /// Closes the program and starts it again with the same home folder.
    void Restart();

    // Actions for the next window, set before it opens. Each window uses one.
    /// For a message box: clicks the button with a name ("ok", "yes").
    void WillAnswer(const char* button);
    /// For a file dialog: types a path and accepts; cancels if the path is empty.
    void WillChooseFile(const std::string& path);
    /// For the folder chooser: types a folder, selects a filter (starting at 1), accepts.
    void WillChooseFolder(const std::string& folder, int filter);
    /// Texts of the message boxes so far.
    QStringList m_kBoxes;
    QPointer<QWidget> m_pkAsker; ///< window of the last one
    QString m_kDetails;          ///< of the last one
    bool m_bUnfolded = false;    ///< whether they were visible from the start

    void Wait(int milliseconds);

private:
    void Start();

    CTempHome m_kHome;
    std::unique_ptr<CSystemPlatform> m_spPlatform;
    std::set<EKey> m_kHeld; // on the keyboard, whichever window has the focus
    CLeftKeys m_kKeys{[this] { return m_kHeld; }};
    CSkin m_kSkin;
    std::unique_ptr<CGaitConvertFrame> m_spFrame;
    CDialogAnswers m_kAnswers;
};

/// Returns the path of one of the project's example motions.
std::string ExampleFile(std::string_view name);

} // namespace gw
