// Requests to the desktop. A script takes the place of the programs that open things, an object on the
// session bus that of the file manager.

#include "DesktopServices.h"
#include "CDialogAnswers.h"
#include "Paths.h"
#include "TempFolder.h"

#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusVirtualObject>
#include <QFile>
#include <QTest>
#include <gtest/gtest.h>

namespace gw {
namespace {

class CFileManager : public QDBusVirtualObject
{
public:
    QString introspect(const QString&) const override { return {}; }
    bool handleMessage(const QDBusMessage& message, const QDBusConnection& connection) override
    {
        m_kShown += message.arguments().value(0).toStringList();
        return message.member() == QStringLiteral("ShowItems") && connection.send(message.createReply());
    }

    QStringList m_kShown;
};

// All tests share the script, because the toolkit looks up the opening program only once.
class DesktopServices : public testing::Test
{
protected:
    DesktopServices() : m_kOldPath(qgetenv("PATH"))
    {
        const std::string folder = qgetenv("HOME").toStdString() + "/bin/";
        CreateFolder(folder);
        WriteBytes(folder + "xdg-open", "#!/bin/sh\nprintf %s \"$1\" >\"$HOME/opening\"\n"
                                        "mv \"$HOME/opening\" \"$HOME/opened\"\n");
        QFile::setPermissions(QString::fromStdString(folder + "xdg-open"), QFile::Permissions(0x7700));
        qputenv("PATH", QByteArray::fromStdString(folder) + ':' + m_kOldPath);
    }
    ~DesktopServices() override
    {
        DeleteFile(OpenedFile());
        qputenv("PATH", m_kOldPath);
    }

    static std::string OpenedFile() { return qgetenv("HOME").toStdString() + "/opened"; }

    // Returns what was opened since the last call.
    static std::string Opened()
    {
        EXPECT_TRUE(WaitUntil([] { return FileExists(OpenedFile()); }));
        std::string opened = ReadBytes(OpenedFile());
        DeleteFile(OpenedFile());
        return opened;
    }

    QByteArray m_kOldPath;
};

TEST_F(DesktopServices, OpenAPageAndAHelpFileWithoutItsTopic)
{
    const CTempFolder folder;
    EXPECT_TRUE(OpenWebPage("https://tessarine.example/gaitwright?lang=enu"));
    EXPECT_EQ(Opened(), "https://tessarine.example/gaitwright?lang=enu");
    OpenHelpFile(folder.Path("Kestro.chm::/Using_Gaitwright.htm"));
    EXPECT_EQ(Opened(), "file://" + folder.Path("Kestro.chm"));
    OpenHelpFile(folder.Path("Kestro.chm"));
    EXPECT_EQ(Opened(), "file://" + folder.Path("Kestro.chm"));
}

TEST_F(DesktopServices, ShowTheFolderWhereThereIsNoFileManager)
{
    const CTempFolder folder;
    ShowInFileManager(folder.Path("walk.htr"));
    EXPECT_EQ(Opened() + '/', "file://" + folder.Path());
}

TEST_F(DesktopServices, ShowTheFileInTheFileManager)
{
    const QString name = QStringLiteral("manager");
    QDBusConnection bus = QDBusConnection::connectToBus(QDBusConnection::SessionBus, name);
    CFileManager manager;
    if (!bus.isConnected() || !bus.registerService(QStringLiteral("org.freedesktop.FileManager1")))
        GTEST_SKIP() << "no session bus, or one with a file manager of its own";
    bus.registerVirtualObject(QStringLiteral("/org/freedesktop/FileManager1"), &manager);
    ShowInFileManager("/takes/walk #1.htr");
    EXPECT_TRUE(WaitUntil([&] { return !manager.m_kShown.isEmpty(); }));
    EXPECT_EQ(manager.m_kShown, QStringList(QStringLiteral("file:///takes/walk%20%231.htr")));
    QTest::qWait(50);
    EXPECT_FALSE(FileExists(OpenedFile())); // the folder was not opened as well
    QDBusConnection::disconnectFromBus(name);
}

} // namespace
} // namespace gw
