// Creates and arranges the controls of the profile editor; CProfileEditorWindow connects them.

#include "CEditorControls.h"

#include "CBoneTreeView.h"
#include "CElidedLabel.h"
#include "CFieldEdit.h"
#include "CMapRowView.h"
#include "CProfileEditorDialog.h"

#include <QCoreApplication>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QVBoxLayout>
#include <algorithm>
#include <iterator>

namespace gw {

namespace {

struct ButtonRow
{
    int id;
    const char* text;
    bool ProfileButtons::*enabled;
};

constexpr ButtonRow kButtonRows[] = {
    {kAddToMapButton,    "Add to Map",   &ProfileButtons::addToMap   },
    {kBoneOffsetButton,  "Bone Offset",  &ProfileButtons::boneOffset },
    {kRemoveButton,      "Remove",       &ProfileButtons::remove     },
    {kRemoveAllButton,   "Remove All",   &ProfileButtons::removeAll  },
    {kSaveProfileButton, "Save Profile", &ProfileButtons::saveProfile},
};

// Controls that the window has but never shows. A file's offset is entered through the fields.
constexpr ButtonRow kUnusedButtons[] = {
    {3, "Auto-Mapping", nullptr},
    {4, "Auto-Offset",  nullptr},
};
constexpr int kUnusedFields[] = {kOffsetXField, kOffsetYField, kOffsetZField};

constexpr int kTreeStretch = 3;
constexpr int kRowStretch = 2;

QString Name(int id)
{
    return QString::number(id);
}

QString Translated(const char* text)
{
    return QCoreApplication::translate("QObject", text);
}

} // namespace

CEditorControls::CEditorControls(const CGaitConvertContent& content, QWidget* window) : m_pkWindow(window)
{
    auto* const layout = new QVBoxLayout(window);
    layout->addLayout(MakeFields());
    layout->addLayout(MakeTrees(), kTreeStretch);
    layout->addLayout(MakePairLine());
    layout->addLayout(MakeRows(content), kRowStretch);
    layout->addLayout(MakeRowButtons());
    MakeUnusedControls();
}

QLayout* CEditorControls::MakeFields()
{
    CFieldEdit* const name = MakeField(kNameField, QObject::tr("Bone Map Name:"));
    CFieldEdit* const rate = MakeField(kFrameRateField, QObject::tr("Frame Rate:"));
    rate->setAlignment(Qt::AlignRight);
    rate->setFixedWidth(rate->fontMetrics().horizontalAdvance(QStringLiteral("000000000")));
    auto* const line = new QHBoxLayout;
    line->addWidget(MakeLabel(QObject::tr("Bone Map Name:"), name));
    line->addWidget(name);
    line->addSpacing(name->fontMetrics().height());
    line->addWidget(MakeLabel(QObject::tr("Frame Rate:"), rate));
    line->addWidget(rate);
    return line;
}

QLayout* CEditorControls::MakeTrees()
{
    auto* const line = new QHBoxLayout;
    line->addLayout(MakeTree(kSourceTree, QObject::tr("Source Bones:"), m_pkSourceTree));
    line->addLayout(MakeTree(kTargetTree, QObject::tr("Kestro TK Bones:"), m_pkTargetTree));
    return line;
}

QLayout* CEditorControls::MakeTree(int id, const QString& title, CBoneTreeView*& tree)
{
    CFieldEdit* const search = MakeSearch(id, QObject::tr("Find in %1").arg(title));
    tree = new CBoneTreeView(m_pkWindow);
    tree->setObjectName(Name(id));
    tree->setAccessibleName(title);
    m_kSearches.push_back({search, tree});
    return Titled(tree, search, 1);
}

CFieldEdit* CEditorControls::MakeSearch(int tree, const QString& name)
{
    auto* const search = new CFieldEdit(m_pkWindow);
    search->setObjectName(QStringLiteral("search") + Name(tree));
    search->setAccessibleName(name);
    search->setPlaceholderText(QObject::tr("Find (Ctrl+F)"));
    search->setToolTip(
        QObject::tr("Part of a bone's name. Enter selects the first match, Down the next ones; "
                    "Escape clears the search."));
    search->setClearButtonEnabled(true);
    return search;
}

QLayout* CEditorControls::MakePairLine()
{
    m_pkPair = new CElidedLabel(m_pkWindow);
    m_pkPair->setObjectName(QStringLiteral("pair"));
    m_pkPair->setAccessibleName(QObject::tr("Bones to map"));
    auto* const line = new QHBoxLayout;
    line->addWidget(m_pkPair, 1);
    line->addWidget(MakeButton(kAddToMapButton));
    return line;
}

QLayout* CEditorControls::MakeRows(const CGaitConvertContent& content)
{
    m_pkRows = new CMapRowView(content, m_pkWindow);
    m_pkRows->setObjectName(Name(kMapRowList));
    m_pkRows->setAccessibleName(QObject::tr("Bone Map List:"));
    const QString keys = QObject::tr("Remove: Delete    Undo: Ctrl+Z    Redo: Ctrl+Y");
    return Titled(m_pkRows, MakeHint(keys, QStringLiteral("undoHint")), 0);
}

QLayout* CEditorControls::MakeRowButtons()
{
    auto* const line = new QHBoxLayout;
    for (const int id : {kBoneOffsetButton, kRemoveButton, kRemoveAllButton})
        line->addWidget(MakeButton(id));
    line->addStretch();
    line->addWidget(MakeButton(kSaveProfileButton));
    return line;
}

void CEditorControls::MakeUnusedControls()
{
    for (const ButtonRow& row : kUnusedButtons)
    {
        auto* const button = new QPushButton(Translated(row.text), m_pkWindow);
        button->setObjectName(Name(row.id));
        button->hide();
    }
    auto* const group = new QGroupBox(QObject::tr("Root Offset:"), m_pkWindow);
    group->setObjectName(QStringLiteral("rootOffset"));
    for (const int id : kUnusedFields)
        MakeField(id, group->title())->setParent(group);
    group->hide();
}

CFieldEdit* CEditorControls::MakeField(int id, const QString& name)
{
    auto* const edit = new CFieldEdit(m_pkWindow);
    edit->setObjectName(Name(id));
    edit->setAccessibleName(name);
    m_kFields.push_back({id, edit});
    return edit;
}

QPushButton* CEditorControls::MakeButton(int id)
{
    const ButtonRow& row = *std::ranges::find(kButtonRows, id, &ButtonRow::id);
    auto* const button = new QPushButton(Translated(row.text), m_pkWindow);
    button->setObjectName(Name(id));
    button->setAutoDefault(false); // Enter belongs to the fields
    m_kButtons.push_back({id, row.enabled, button});
    return button;
}

QLayout* CEditorControls::Titled(QWidget* widget, QWidget* beside, int stretch)
{
    auto* const heading = new QHBoxLayout;
    heading->addWidget(MakeLabel(widget->accessibleName(), widget));
    if (stretch == 0)
        heading->addStretch();
    heading->addWidget(beside, stretch);
    auto* const column = new QVBoxLayout;
    column->addLayout(heading);
    column->addWidget(widget);
    return column;
}

QLabel* CEditorControls::MakeLabel(const QString& text, QWidget* buddy)
{
    auto* const label = new QLabel(text, m_pkWindow);
    label->setObjectName(QStringLiteral("label-") + buddy->objectName());
    label->setBuddy(buddy);
    return label;
}

QLabel* CEditorControls::MakeHint(const QString& text, const QString& name)
{
    auto* const hint = new QLabel(text, m_pkWindow);
    hint->setObjectName(name);
    hint->setProperty("kind", QStringLiteral("caption")); // the style sheet makes it unobtrusive
    return hint;
}

} // namespace gw
