// Selecting a folder with the mouse and by its path.

#include "CDialogAnswers.h"
#include "CSelectFolderDialog.h"
#include "Paths.h"
#include "TempFolder.h"
#include "Widgets.h"

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QTest>
#include <gtest/gtest.h>

namespace gw {
namespace {

constexpr const char* kFilter = "BVH file to HTR(*.bvh)|*.bvh|HTR file to ORN(*.htr)|*.htr|";

// A folder with two folders and two files, and a user who selects one.
class SelectFolder : public testing::Test
{
protected:
    SelectFolder()
    {
        CreateFolder(m_kFolder.Path("day 1"));
        CreateFolder(m_kFolder.Path("day 2"));
        WriteBytes(m_kFolder.Path("a.bvh"), "a");
        WriteBytes(m_kFolder.Path("B.BVH"), "b");
        WriteBytes(m_kFolder.Path("c.htr"), "c");
    }

    // Opens the dialog in the folder, replacing an earlier dialog.
    CSelectFolderDialog& Open(const std::string& filter = {}, const std::string& initial = {})
    {
        m_pkDialog = std::make_unique<CSelectFolderDialog>(
            nullptr, FileDialogSetup{{}, filter, initial.empty() ? m_kFolder.Path() : initial});
        m_pkDialog->show();
        Activate(*m_pkDialog);
        return *m_pkDialog;
    }

    template <class Widget>
    Widget* Child(const char* name)
    {
        return m_pkDialog->findChild<Widget*>(QLatin1String(name));
    }
    std::string Path() { return Child<QLineEdit>("102")->text().toStdString(); }
    void Click(const char* name) { QTest::mouseClick(Child<QWidget>(name), Qt::LeftButton); }

    void Write(const std::string& path) { TypeInto(*Child<QLineEdit>("102"), QString::fromStdString(path)); }

    // Waits until the list contains these names, with brackets around those that cannot be selected, and
    // returns its contents.
    std::vector<std::string> Listed(const std::vector<std::string>& expected)
    {
        auto* list = Child<QAbstractItemView>("folders");
        std::vector<std::string> names;
        const auto read = [&] {
            names.clear();
            for (int row = 0; row < list->model()->rowCount(list->rootIndex()); ++row)
            {
                const QModelIndex index = list->model()->index(row, 0, list->rootIndex());
                const std::string name = index.data().toString().toStdString();
                names.push_back(index.flags() & Qt::ItemIsEnabled ? name : "[" + name + "]");
            }
            return names == expected;
        };
        (void)WaitUntil(read);
        return names;
    }
    void ExpectListed(const std::vector<std::string>& expected) { EXPECT_EQ(Listed(expected), expected); }

    // Presses "select", and the button of the box that then opens. Returns the box's text.
    std::string SelectAndAnswer(const char* button)
    {
        std::string text;
        const CDialogAnswers answers([&](QWidget& box) {
            text = box.findChild<QLabel*>(QStringLiteral("text"))->accessibleName().toStdString();
            QTest::mouseClick(box.findChild<QWidget*>(QLatin1String(button)), Qt::LeftButton);
        });
        Click("select");
        return text;
    }

    CTempFolder m_kFolder;
    std::unique_ptr<CSelectFolderDialog> m_pkDialog;
};

TEST_F(SelectFolder, ListsFoldersAndWithAFilterTheFilesThatItTakes)
{
    Open();
    EXPECT_EQ(m_pkDialog->windowTitle().toStdString(), "Select folder");
    EXPECT_EQ(Child<QAbstractButton>("select")->text().toStdString(), "Select");
    EXPECT_EQ(Child<QLabel>("currentFolder")->text().toStdString(), "Current Folder");
    ExpectListed({"day 1", "day 2"});
    EXPECT_EQ(Child<QWidget>("filter"), nullptr);
    const int plainHeight = m_pkDialog->height();

    Open(kFilter);
    EXPECT_EQ(m_pkDialog->height(), plainHeight + 35);
    ExpectListed({"day 1", "day 2", "[a.bvh]", "[B.BVH]"});
    Child<QComboBox>("filter")->setCurrentIndex(1);
    ExpectListed({"day 1", "day 2", "[c.htr]"});
    Click("select");
    EXPECT_EQ(m_pkDialog->Choice().filterIndex, 2);
}

TEST_F(SelectFolder, GoesIntoFoldersAndUpAgain)
{
    Open();
    ExpectListed({"day 1", "day 2"});
    auto* list = Child<QAbstractItemView>("folders");
    list->setFocus();
    list->setCurrentIndex(list->model()->index(1, 0, list->rootIndex()));
    EXPECT_EQ(Path() + '/', m_kFolder.Path()); // a folder that is only selected is not opened
    QTest::keyClick(list, Qt::Key_Return);
    EXPECT_EQ(Path(), m_kFolder.Path("day 2"));
    EXPECT_TRUE(m_pkDialog->isVisible());
    Click("up");
    EXPECT_EQ(Path() + '/', m_kFolder.Path());
    EXPECT_EQ(list->currentIndex().data().toString().toStdString(), "day 2");
    Click("select");
    EXPECT_EQ(m_pkDialog->result(), QDialog::Accepted);
    EXPECT_EQ(m_pkDialog->Choice().folder, m_kFolder.Path());

    Open({}, "/");
    EXPECT_FALSE(Child<QWidget>("up")->isEnabled());
    Click("select");
    EXPECT_EQ(m_pkDialog->Choice().folder, "/");
}

TEST_F(SelectFolder, TakesAPathThatIsWritten)
{
    for (const std::string& text : {m_kFolder.Path("day 1"), std::string("day 1\\")})
    {
        Open();
        Write(text);
        QTest::keyClick(Child<QWidget>("102"), Qt::Key_Return);
        EXPECT_EQ(m_pkDialog->result(), QDialog::Accepted);
        EXPECT_EQ(m_pkDialog->Choice().folder, m_kFolder.Path("day 1/"));
    }
}

TEST_F(SelectFolder, StaysWithTwoSeparatorsInARow)
{
    Open();
    Write("/takes\\\\day 1");
    EXPECT_EQ(SelectAndAnswer("ok"), "Invalid Folder");
    EXPECT_TRUE(m_pkDialog->isVisible());
    EXPECT_EQ(Path(), "/takes\\\\day 1");
}

TEST_F(SelectFolder, TakesAMissingFolderWhateverIsAnsweredAndMakesNone)
{
    for (const char* button : {"yes", "no"})
    {
        Open();
        Write(m_kFolder.Path("none/"));
        EXPECT_EQ(SelectAndAnswer(button),
                  m_kFolder.Path("none") + "\n\nThis path does not exist. Do you want to create it?");
        EXPECT_EQ(m_pkDialog->result(), QDialog::Accepted);
        EXPECT_EQ(m_pkDialog->Choice().folder, m_kFolder.Path("none/"));
        EXPECT_FALSE(FolderExists(m_kFolder.Path("none")));
    }
}

TEST_F(SelectFolder, AnswersNothingWhenItIsCancelled)
{
    const CDialogAnswers answers([](QWidget& dialog) { QTest::keyClick(&dialog, Qt::Key_Escape); });
    EXPECT_FALSE(AskFolder(nullptr, {{}, kFilter, m_kFolder.Path("gone with a disk")}));
}

} // namespace
} // namespace gw
