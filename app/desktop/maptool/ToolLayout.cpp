// The layout of the map tool's window: three columns, each from top to bottom in working order, which is also
// the Tab order.

#include "AboutBox.h"
#include "CBoneTreeView.h"
#include "CGaitToolWindow.h"
#include "CIconButton.h"
#include "CMotionPanel.h"
#include "QtText.h"
#include "StringTable.h"

#include <QCoreApplication>
#include <QGridLayout>
#include <QLabel>
#include <QListView>
#include <QMenu>
#include <QScreen>
#include <QShortcut>
#include <algorithm>

namespace gw {

namespace {

constexpr QSize kWindowSize(1080, 800); // if the screen is large enough
constexpr QSize kFrameSize(12, 40);     // guess of what the window manager adds
constexpr int kMargin = 12;
constexpr int kGap = 8;
constexpr int kColumns = 3;

enum ERow : int
{
    kTopRow,
    kPanelRow,
    kFileRow,
    kTreeRow,
    kEditRow,
    kStatusRow,
};

struct ButtonText
{
    int m_iID;
    const char* m_pcText;
};

constexpr ButtonText kButtonTexts[] = {
    {kToolLoadSource, QT_TRANSLATE_NOOP("GaitTool", "Load Source Anm File")},
    {kToolLoadTarget, QT_TRANSLATE_NOOP("GaitTool", "Load Target Anm File")},
    {kToolAddToMap,   QT_TRANSLATE_NOOP("GaitTool", "Add to Map")          },
    {kToolDelete,     QT_TRANSLATE_NOOP("GaitTool", "Delete")              },
    {kToolDeleteAll,  QT_TRANSLATE_NOOP("GaitTool", "Delete All")          },
    {kToolLoadMap,    QT_TRANSLATE_NOOP("GaitTool", "Load Map")            },
    {kToolSaveMap,    QT_TRANSLATE_NOOP("GaitTool", "Save Map")            },
    {kToolConvert,    QT_TRANSLATE_NOOP("GaitTool", "Convert")             },
    {kToolSaveResult, QT_TRANSLATE_NOOP("GaitTool", "Save result")         },
    {kToolDetail,     QT_TRANSLATE_NOOP("GaitTool", "Detail...")           },
    {kToolClose,      QT_TRANSLATE_NOOP("GaitTool", "Close")               },
};

QString ToolText(const char* text)
{
    return QCoreApplication::translate("GaitTool", text);
}

} // namespace

void CGaitToolWindow::MakeLayout(const CLeftKeys& keys)
{
    auto* const grid = new QGridLayout(this);
    grid->setContentsMargins(kMargin, kMargin, kMargin, kMargin);
    grid->setHorizontalSpacing(2 * kGap);
    grid->setVerticalSpacing(kGap);
    for (int column = 0; column < kColumns; ++column)
        grid->setColumnStretch(column, 1);
    grid->setRowStretch(kPanelRow, 3);
    grid->setRowStretch(kTreeRow, 2);
    MakeTop(*grid);
    MakePanels(*grid, keys);
    MakeTrees(*grid);
    MakeLines(*grid);
    MakeStatus(*grid);
    resize(kWindowSize.boundedTo(screen()->availableSize() - kFrameSize));
    findChild<QPushButton*>(QString::number(kToolLoadSource))->setFocus();
}

void CGaitToolWindow::MakeMenu()
{
    m_pkMenu = new QMenu(this);
    m_pkMenu->setObjectName(QStringLiteral("windowMenu"));
    m_pkMenu->addAction(ToolText("Close"), this, [this] { Click(kToolClose); });
    m_pkMenu->addSeparator();
    m_pkMenu->addAction(ToQString(BuiltInString(kAboutToolMessage)), this, [this] { ShowAboutBox(*this); });
}

void CGaitToolWindow::MakeTop(QGridLayout& grid)
{
    auto* const hint =
        new QLabel(ToolText("Select a bone in each tree and add the pair to the map. Then convert."), this);
    hint->setObjectName(QStringLiteral("hint"));
    hint->setProperty("kind", QStringLiteral("caption"));
    grid.addWidget(hint, kTopRow, 0, 1, kColumns - 1);
    auto* const menu = new CIconButton(EButtonIcon::Menu, ToolText("Window menu"), this);
    menu->setObjectName(QStringLiteral("menuButton"));
    connect(menu, &QPushButton::clicked, this, [this, menu] {
        // Aligned at the right edges, so that the menu stays within the window.
        const QPoint below = menu->mapToGlobal(menu->rect().bottomRight());
        m_pkMenu->popup(below - QPoint(m_pkMenu->sizeHint().width(), 0));
    });
    grid.addWidget(menu, kTopRow, kColumns - 1, Qt::AlignRight);
}

void CGaitToolWindow::MakePanels(QGridLayout& grid, const CLeftKeys& keys)
{
    for (const EToolMotion motion : kToolMotions)
    {
        const int column = static_cast<int>(motion);
        auto* const panel = new CMotionPanel(motion, keys, this);
        panel->SetClicked([this](int id) { Click(id); });
        panel->SetBoneClicked([this, motion](const std::string& bone) { ClickBone(motion, bone); });
        if (motion != EToolMotion::Result)
        {
            panel->SetDropped([this, motion](const QString& path) {
                Forward([&] { m_kTool.DropFile(motion, ToUtf8(path)); });
            });
        }
        grid.addWidget(panel, kPanelRow, column);
        m_kPanels[static_cast<size_t>(column)] = panel;
    }
}

void CGaitToolWindow::MakeTrees(QGridLayout& grid)
{
    grid.addLayout(MakeButtons({kToolLoadSource}), kFileRow, 0);
    grid.addLayout(MakeButtons({kToolLoadTarget}), kFileRow, 1);
    m_pkSourceTree = new CBoneTreeView(this);
    m_pkSourceTree->setObjectName(QStringLiteral("sourceTree"));
    m_pkSourceTree->setAccessibleName(ToolText("Source bones"));
    m_pkSourceTree->SetOnSelect([this](int item) { Forward([&] { m_kTool.SelectSourceItem(item); }); });
    grid.addWidget(m_pkSourceTree, kTreeRow, 0);
    m_pkTargetTree = new CBoneTreeView(this);
    m_pkTargetTree->setObjectName(QStringLiteral("targetTree"));
    m_pkTargetTree->setAccessibleName(ToolText("Target bones"));
    m_pkTargetTree->SetOnSelect([this](int item) { Forward([&] { m_kTool.SelectTargetItem(item); }); });
    grid.addWidget(m_pkTargetTree, kTreeRow, 1);
    grid.addLayout(MakeButtons({kToolAddToMap}), kEditRow, 0, 1, 2);
}

void CGaitToolWindow::MakeLines(QGridLayout& grid)
{
    grid.addLayout(MakeButtons({kToolLoadMap, kToolSaveMap}), kFileRow, kColumns - 1);
    m_pkLines = new QListView(this);
    m_pkLines->setObjectName(QString::number(kToolLines));
    m_pkLines->setAccessibleName(ToolText("Map lines"));
    m_pkLines->setModel(&m_kLineTexts);
    m_pkLines->setEditTriggers(QAbstractItemView::NoEditTriggers);
    m_pkLines->setUniformItemSizes(true);
    m_pkLines->setSpacing(1);
    // Arrow keys change the current line; clicking the current line counts as selecting it too.
    const auto select = [this](const QModelIndex& line) { SelectLine(line); };
    connect(m_pkLines->selectionModel(), &QItemSelectionModel::currentChanged, this, select);
    connect(m_pkLines, &QListView::clicked, this, select);
    connect(m_pkLines, &QListView::doubleClicked, this, [this] { Click(kToolDetail); });
    auto* const remove = new QShortcut(QKeySequence::Delete, m_pkLines, nullptr, nullptr, Qt::WidgetShortcut);
    connect(remove, &QShortcut::activated, this, [this] { Click(kToolDelete); });
    grid.addWidget(m_pkLines, kTreeRow, kColumns - 1);
    grid.addLayout(MakeButtons({kToolDetail, kToolDelete, kToolDeleteAll}), kEditRow, kColumns - 1);
}

void CGaitToolWindow::MakeStatus(QGridLayout& grid)
{
    m_pkStatus = new QLabel(this);
    m_pkStatus->setObjectName(QStringLiteral("status"));
    m_pkStatus->setAccessibleName(ToolText("Status"));
    m_pkStatus->setTextFormat(Qt::PlainText);
    m_pkStatus->setWordWrap(true);
    // Always two lines high, so that nothing moves when the text changes, and no text widens the window.
    m_pkStatus->setFixedHeight(2 * fontMetrics().lineSpacing());
    m_pkStatus->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Fixed);
    grid.addWidget(m_pkStatus, kStatusRow, 0, 1, kColumns - 1);
    grid.addLayout(MakeButtons({kToolConvert, kToolSaveResult, kToolClose}), kStatusRow, kColumns - 1);
    findChild<QPushButton*>(QString::number(kToolConvert))->setProperty("kind", QStringLiteral("primary"));
}

QLayout* CGaitToolWindow::MakeButtons(std::initializer_list<int> ids)
{
    auto* const row = new QHBoxLayout;
    row->setSpacing(kGap);
    for (const int id : ids)
        row->addWidget(MakeButton(id));
    return row;
}

QPushButton* CGaitToolWindow::MakeButton(int id)
{
    const auto* const text = std::ranges::find(kButtonTexts, id, &ButtonText::m_iID);
    auto* const button = new QPushButton(ToolText(text->m_pcText), this);
    button->setObjectName(QString::number(id));
    button->setAccessibleName(button->text());
    button->setAutoDefault(false); // Enter in a tree or list must not click it
    button->setSizePolicy(QSizePolicy::Minimum, QSizePolicy::Preferred); // same height as its row
    connect(button, &QPushButton::clicked, this, [this, id] { Click(id); });
    m_kButtons.push_back(button);
    return button;
}

} // namespace gw
