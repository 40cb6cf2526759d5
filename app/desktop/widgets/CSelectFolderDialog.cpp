// The folder dialog: a list that opens folders, and a path that can be edited.

#include "CSelectFolderDialog.h"

#include "CMessageBox.h"
#include "DialogParts.h"
#include "FileFilter.h"
#include "FolderText.h"
#include "Paths.h"
#include "QtText.h"

#include <QApplication>
#include <QBoxLayout>
#include <QComboBox>
#include <QCoreApplication>
#include <QDir>
#include <QFileSystemModel>
#include <QIcon>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QListView>
#include <QPixmap>
#include <QPushButton>
#include <QStandardPaths>
#include <QStyle>
#include <QToolButton>

namespace gw {

namespace {

constexpr int kWidth = 520;
constexpr int kHeight = 400;
constexpr int kIconSide = 16;
constexpr int kFilterHeight = 35; // additional height if a filter is shown

QString DialogText(const char* text)
{
    return QCoreApplication::translate("CSelectFolderDialog", text);
}

// Files are shown only so that the user recognizes the folder, and cannot be chosen. The model's own icons
// exist only with a desktop theme.
class CFolderModel : public QFileSystemModel
{
public:
    explicit CFolderModel(QObject* parent)
        : QFileSystemModel(parent), m_kFolderIcon(QApplication::style()->standardIcon(QStyle::SP_DirIcon)),
          m_kNoIcon(kIconSide, kIconSide)
    {
        m_kNoIcon.fill(Qt::transparent);
    }

    Qt::ItemFlags flags(const QModelIndex& index) const override
    {
        const Qt::ItemFlags all = QFileSystemModel::flags(index);
        return isDir(index) ? all : all & ~(Qt::ItemIsEnabled | Qt::ItemIsSelectable);
    }

    QVariant data(const QModelIndex& index, int role) const override
    {
        if (role != Qt::DecorationRole)
            return QFileSystemModel::data(index, role);
        return isDir(index) ? QVariant(m_kFolderIcon) : QVariant(m_kNoIcon);
    }

private:
    QIcon m_kFolderIcon;
    QPixmap m_kNoIcon; // keeps the names aligned
};

QString BeginningFolder(const std::string& wanted)
{
    const QString folders[] = {ToQString(wanted),
                               QStandardPaths::writableLocation(QStandardPaths::DocumentsLocation)};
    for (const QString& folder : folders)
    {
        if (!folder.isEmpty() && QDir(folder).exists())
            return QDir(folder).absolutePath();
    }
    return QDir::homePath();
}

QStringList Patterns(const FileFilter& choice)
{
    QStringList patterns;
    for (const std::string& pattern : choice.patterns)
        patterns << ToQString(pattern);
    return patterns;
}

} // namespace

CSelectFolderDialog::CSelectFolderDialog(QWidget* owner, const FileDialogSetup& setup)
    : QDialog(owner), m_pkModel(new CFolderModel(this))
{
    Named(this, "selectFolder", DialogText("Select folder"));
    setWindowTitle(DialogText("Select folder"));
    m_pkModel->setFilter(QDir::AllDirs | QDir::Drives | QDir::NoDotAndDotDot);
    m_pkModel->setNameFilterDisables(false);
    m_pkModel->sort(0);

    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(kDialogMargin, kDialogMargin, kDialogMargin, kDialogMargin);
    layout->setSpacing(kDialogSpacing);
    layout->addLayout(MakePathRow());
    layout->addWidget(MakeList());
    if (!setup.filter.empty())
        layout->addLayout(MakeFilterRow(setup.filter));
    if (!setup.note.empty())
    {
        auto* const note = Named(new QLabel(ToQString(setup.note), this), "note", ToQString(setup.note));
        note->setTextFormat(Qt::PlainText);
        note->setWordWrap(true);
        layout->addWidget(note);
    }
    layout->addSpacing(kDialogSpacing);
    layout->addLayout(MakeButtons());
    resize(kWidth, m_pkFilter ? kHeight + kFilterHeight : kHeight);
    OpenFolder(BeginningFolder(setup.initialFolder));
}

QLayout* CSelectFolderDialog::MakePathRow()
{
    auto* label =
        Named(new QLabel(DialogText("Current Folder"), this), "currentFolder", DialogText("Current Folder"));
    m_pkPath = Named(new QLineEdit(this), "102", DialogText("Current Folder"));
    label->setBuddy(m_pkPath);
    m_pkUp = Named(new QToolButton(this), "up", DialogText("Up one folder"));
    m_pkUp->setArrowType(Qt::UpArrow);
    m_pkUp->setToolTip(DialogText("Up one folder (Alt+Up)"));
    m_pkUp->setShortcut(Qt::ALT | Qt::Key_Up);
    m_pkUp->setFocusPolicy(Qt::StrongFocus);
    connect(m_pkUp, &QToolButton::clicked, this, [this] { OpenParent(); });

    auto* row = new QHBoxLayout;
    row->addWidget(m_pkPath);
    row->addWidget(m_pkUp);
    auto* column = new QVBoxLayout;
    column->addWidget(label);
    column->addLayout(row);
    return column;
}

QWidget* CSelectFolderDialog::MakeList()
{
    m_pkFolders = Named(new QListView(this), "folders", DialogText("Folders"));
    m_pkFolders->setModel(m_pkModel);
    m_pkFolders->setUniformItemSizes(true);
    m_pkFolders->setSpacing(2);
    m_pkFolders->setIconSize(QSize(kIconSide, kIconSide));
    connect(m_pkFolders, &QListView::activated, this,
            [this](const QModelIndex& index) { OpenFolder(m_pkModel->filePath(index)); });
    return m_pkFolders;
}

QLayout* CSelectFolderDialog::MakeFilterRow(const std::string& filter)
{
    auto* label =
        Named(new QLabel(DialogText("&Files shown"), this), "filterLabel", DialogText("Files shown"));
    m_pkFilter = Named(new QComboBox(this), "filter", DialogText("Files shown"));
    label->setBuddy(m_pkFilter);
    connect(m_pkFilter, &QComboBox::currentIndexChanged, this,
            [this](int choice) { m_pkModel->setNameFilters(m_pkFilter->itemData(choice).toStringList()); });
    m_pkModel->setFilter(m_pkModel->filter() | QDir::Files);
    for (const FileFilter& choice : SplitFilter(filter))
        m_pkFilter->addItem(ToQString(choice.text), Patterns(choice));

    auto* row = new QHBoxLayout;
    row->addWidget(label);
    row->addWidget(m_pkFilter, 1);
    return row;
}

QLayout* CSelectFolderDialog::MakeButtons()
{
    auto* select = Named(new QPushButton(DialogText("Select"), this), "select", DialogText("Select"));
    select->setDefault(true);
    auto* cancel = Named(new QPushButton(DialogText("Cancel"), this), "cancel", DialogText("Cancel"));
    connect(select, &QPushButton::clicked, this, [this] { accept(); });
    connect(cancel, &QPushButton::clicked, this, [this] { reject(); });

    auto* row = new QHBoxLayout;
    row->addStretch();
    for (QPushButton* button : {select, cancel})
    {
        button->setMinimumWidth(kButtonWidth);
        row->addWidget(button);
    }
    return row;
}

void CSelectFolderDialog::OpenFolder(const QString& path)
{
    m_pkFolders->setRootIndex(m_pkModel->setRootPath(path));
    m_pkPath->setText(QDir::toNativeSeparators(path));
    m_pkUp->setEnabled(!QDir(path).isRoot());
}

void CSelectFolderDialog::OpenParent()
{
    const QString child = FolderThatIsOpen();
    OpenFolder(QFileInfo(child).absolutePath());
    m_pkFolders->setCurrentIndex(m_pkModel->index(child));
}

QString CSelectFolderDialog::FolderThatIsOpen() const
{
    return m_pkModel->rootPath();
}

void CSelectFolderDialog::keyPressEvent(QKeyEvent* event)
{
    // The list has opened a folder and passes the key on, which would close the dialog.
    const bool isEnter = event->key() == Qt::Key_Enter || event->key() == Qt::Key_Return;
    if (!isEnter || !m_pkFolders->hasFocus())
        QDialog::keyPressEvent(event);
}

void CSelectFolderDialog::accept()
{
    const std::string title = ToUtf8(windowTitle());
    const auto folder = FolderOfText(ToUtf8(m_pkPath->text()), ToUtf8(FolderThatIsOpen()));
    if (!folder)
    {
        RunMessageBox(this, title, ToUtf8(DialogText("Invalid Folder")), EButtons::OK);
        return;
    }
    // The answer makes no difference, and never has: the caller finds nothing in the folder.
    if (!FolderExists(*folder))
        RunMessageBox(this, title,
                      std::string(FolderName(*folder)) + "\n\n" +
                          ToUtf8(DialogText("This path does not exist. Do you want to create it?")),
                      EButtons::YesNo);
    m_kFolder = *folder;
    QDialog::accept();
}

FolderChoice CSelectFolderDialog::Choice() const
{
    return {m_kFolder, m_pkFilter ? m_pkFilter->currentIndex() + 1 : 1};
}

std::optional<FolderChoice> AskFolder(QWidget* owner, const FileDialogSetup& setup)
{
    CSelectFolderDialog dialog(owner, setup);
    if (dialog.exec() != QDialog::Accepted)
        return std::nullopt;
    return dialog.Choice();
}

} // namespace gw
