// A second start raises the first window, and other clients do no harm.

#include "CDialogAnswers.h"
#include "CInstanceServer.h"
#include "InstanceMessage.h"
#include "TempFolder.h"

#include <QDir>
#include <QFile>
#include <QLocalSocket>
#include <QTest>
#include <future>
#include <gmock/gmock.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <tuple>
#include <unistd.h>

namespace gw {
namespace {

using testing::ElementsAre;

// The program's address, in a runtime folder of the test.
class Instances : public testing::Test
{
protected:
    Instances() : m_kOldFolder(qgetenv("XDG_RUNTIME_DIR"))
    {
        qputenv("XDG_RUNTIME_DIR", m_kFolder.Path().substr(0, m_kFolder.Path().size() - 1).c_str());
    }
    ~Instances() override { qputenv("XDG_RUNTIME_DIR", m_kOldFolder); }

    CInstanceServer::Raise Remember()
    {
        return [this](const std::string& path) { m_kRaised.push_back(path); };
    }

    // Starts a second process; the first one keeps running.
    bool StartAgain(const std::string& path = {})
    {
        auto answer = std::async(std::launch::async, [&] { return RaiseFirstInstance(path); });
        while (answer.wait_for(std::chrono::seconds(0)) != std::future_status::ready)
            QTest::qWait(1);
        QTest::qWait(1); // handles events queued by the request
        return answer.get();
    }

    // Creates a socket at the program's address without a server.
    int OwnAddress()
    {
        sockaddr_un address = {};
        address.sun_family = AF_UNIX;
        const QByteArray path = QFile::encodeName(InstanceSocketPath());
        std::copy(path.begin(), path.end(), address.sun_path);
        const int owner = socket(AF_UNIX, SOCK_STREAM, 0);
        EXPECT_EQ(bind(owner, reinterpret_cast<const sockaddr*>(&address), sizeof address), 0);
        EXPECT_EQ(listen(owner, 5), 0);
        return owner;
    }

    CTempFolder m_kFolder;
    QByteArray m_kOldFolder;
    std::vector<std::string> m_kRaised;
};

TEST_F(Instances, ASecondStartRaisesTheFirstAndHandsItsFileOver)
{
    EXPECT_FALSE(StartAgain("walk.bvh"));
    const CInstanceServer server(Remember());
    EXPECT_TRUE(StartAgain());
    EXPECT_TRUE(StartAgain("/takes/Lauf \xc3\xbc.bvh"));
    EXPECT_TRUE(StartAgain("walk.bvh"));
    EXPECT_TRUE(StartAgain('/' + std::string(kLongestPath, 'x'))); // no file has such a name
    const std::string here = QDir::currentPath().toStdString();
    EXPECT_THAT(m_kRaised, ElementsAre("", "/takes/Lauf \xc3\xbc.bvh", here + "/walk.bvh", ""));
}

TEST_F(Instances, ALivingOwnerKeepsItsName)
{
    const CInstanceServer first(Remember());
    {
        const CInstanceServer second([](const std::string&) { ADD_FAILURE(); });
        EXPECT_TRUE(first.IsListening());
        EXPECT_FALSE(second.IsListening());
    }
    EXPECT_TRUE(StartAgain());
    EXPECT_THAT(m_kRaised, ElementsAre(""));
}

TEST_F(Instances, TheNameOfADeadOwnerIsTakenOver)
{
    close(OwnAddress()); // the file remains
    ASSERT_TRUE(QFile::exists(InstanceSocketPath()));
    EXPECT_FALSE(StartAgain());
    const CInstanceServer server(Remember());
    EXPECT_TRUE(server.IsListening());
    EXPECT_TRUE(StartAgain());
    EXPECT_THAT(m_kRaised, ElementsAre(""));
}

TEST_F(Instances, AnOwnerThatHangsIsNoLivingOne)
{
    const int owner = OwnAddress();
    EXPECT_FALSE(StartAgain());
    close(owner);
}

TEST_F(Instances, WhatIsNoRequestIsPassedOver)
{
    const QByteArray whole = MakeMessage("/takes/walk.bvh");
    const QByteArray flood(1 << 20, 'G');
    const QByteArray endless("GWR1\xff\xff\xff\xff", 8);
    const QByteArray zeroInPath = MakeMessage(std::string("/takes\0/", 8));
    const std::tuple<const char*, QByteArray> rows[] = {
        {"nothing", ""},
        {"the beginning of one", whole.first(11)},
        {"something behind one", whole + 'x'},
        {"a length beyond paths", endless},
        {"a path with a zero", zeroInPath},
        {"a path of no UTF-8", MakeMessage("/takes/\xff\xfe")},
        {"more than anybody says", flood},
    };
    const CInstanceServer server(Remember());
    for (const auto& [what, bytes] : rows)
    {
        SCOPED_TRACE(what);
        QLocalSocket caller;
        caller.connectToServer(InstanceSocketPath());
        ASSERT_TRUE(caller.waitForConnected());
        caller.write(bytes);
        caller.flush();
        QTest::qWait(20);
        EXPECT_EQ(caller.readAll(), QByteArray());
        caller.abort();
        EXPECT_TRUE(StartAgain());
        EXPECT_THAT(m_kRaised, ElementsAre(""));
        m_kRaised.clear();
    }
}

TEST_F(Instances, ARequestMayComeInPieces)
{
    const CInstanceServer server(Remember());
    QLocalSocket caller;
    caller.connectToServer(InstanceSocketPath());
    ASSERT_TRUE(caller.waitForConnected());
    for (const char letter : MakeMessage("/walk.bvh"))
    {
        EXPECT_THAT(m_kRaised, ElementsAre());
        caller.write(&letter, 1);
        caller.flush();
        QTest::qWait(1);
    }
    EXPECT_TRUE(WaitUntil([&] { return !m_kRaised.empty(); }));
    EXPECT_THAT(m_kRaised, ElementsAre("/walk.bvh"));
}

TEST_F(Instances, TheyMeetWhereNobodyElseCanWrite)
{
    const auto folder = [this](const std::string& name, int permissions) {
        const QString path = QString::fromStdString(m_kFolder.Path(name));
        QDir().mkdir(path);
        QFile::setPermissions(path, QFile::Permissions(permissions));
        return path.toStdString();
    };
    qputenv("TMPDIR", m_kFolder.Path().c_str());
    const std::string own = m_kFolder.Path("gaitwright-" + std::to_string(geteuid()));
    const std::string runtime = folder("run", 0x7700);
    const std::string open = folder("open", 0x7777);
    const std::string far = folder(std::string(100, 'x'), 0x7700);
    const std::string none = m_kFolder.Path("none");
    const std::tuple<const char*, std::string, std::string> rows[] = {
        {"the runtime folder", runtime, runtime}, {"one that all can write", open, own},
        {"one that is too long", far, own},       {"one that there is not", none, own},
        {"a relative one", "run", own},           {"none", "", own},
    };
    for (const auto& [what, runtimeFolder, meeting] : rows)
    {
        SCOPED_TRACE(what);
        qputenv("XDG_RUNTIME_DIR", runtimeFolder.c_str());
        EXPECT_EQ(InstanceSocketPath().toStdString(), meeting + "/TK_KESTRO_GAIT_CONV_1");
    }
    folder("gaitwright-" + std::to_string(geteuid()), 0x7777); // as an attacker would create it
    EXPECT_EQ(InstanceSocketPath(), QString());
    EXPECT_FALSE(CInstanceServer(Remember()).IsListening());
    EXPECT_FALSE(RaiseFirstInstance());
    qunsetenv("TMPDIR");
}

} // namespace
} // namespace gw
