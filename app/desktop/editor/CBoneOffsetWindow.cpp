// The window of the offset dialog: fields and boxes on top of CBoneOffsetDialog, which has the rules.

#include "CBoneOffsetWindow.h"

#include "CBoneOffsetDialog.h"
#include "CElidedLabel.h"
#include "CFieldEdit.h"
#include "CGaitConvertContent.h"
#include "CMapRowTable.h"
#include "PairText.h"
#include "QtText.h"

#include <QComboBox>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QVBoxLayout>

namespace gw {

namespace {

// Rows have the names of the list's columns.
QLabel* MakeLabel(const CGaitConvertContent& content, int column, QWidget* buddy)
{
    auto* const label = new QLabel(ToQString(content.Message(kMapColumnTitles[column].messageId)));
    label->setObjectName(QStringLiteral("label-") + buddy->objectName());
    label->setBuddy(buddy);
    return label;
}

QLabel* MakeHeading(const QString& text, const QString& name)
{
    auto* const heading = new QLabel(text);
    heading->setObjectName(name);
    return heading;
}

QString AxisLetter(int axis)
{
    return QString(QChar('X' + axis));
}

} // namespace

CBoneOffsetWindow::CBoneOffsetWindow(const CGaitConvertContent& content, CBoneOffsetDialog& dialog,
                                     QWidget* owner)
    : QDialog(owner), dialog_(dialog)
{
    setObjectName(QStringLiteral("boneOffset"));
    setWindowTitle(QStringLiteral("GaitTool (Bone Offset)"));
    auto* const layout = new QVBoxLayout(this);
    layout->setSizeConstraint(QLayout::SetFixedSize);
    layout->addWidget(MakePair());
    layout->addLayout(MakeNumbers(content));
    layout->addLayout(MakeButtons());
    ShowAxes();
    m_pkRotation[0]->setFocus();
    m_pkRotation[0]->selectAll();
}

QWidget* CBoneOffsetWindow::MakePair()
{
    auto* const pair = new CElidedLabel(this);
    pair->setObjectName(QStringLiteral("offsetPair"));
    pair->setProperty("kind", QStringLiteral("text"));
    pair->ShowText(PairText(dialog_.Source(), dialog_.Target()));
    return pair;
}

QLayout* CBoneOffsetWindow::MakeNumbers(const CGaitConvertContent& content)
{
    auto* const grid = new QGridLayout;
    grid->addWidget(MakeHeading(tr("Rotation in degrees"), QStringLiteral("rotations")), 0, 1);
    grid->addWidget(MakeHeading(tr("From source axis"), QStringLiteral("axes")), 0, 4);
    for (int axis = 0; axis < kAxisCount; ++axis)
    {
        QWidget* const rotation = MakeRotation(axis);
        grid->addWidget(MakeLabel(content, kRotationColumn + axis, rotation), axis + 1, 0);
        grid->addWidget(rotation, axis + 1, 1);
    }
    for (int axis = 0; axis < kAxisCount; ++axis)
    {
        QWidget* const box = MakeAxis(axis);
        grid->addWidget(MakeLabel(content, kAxisColumn + axis, box), axis + 1, 3);
        grid->addWidget(box, axis + 1, 4);
    }
    grid->setColumnMinimumWidth(2, fontMetrics().height());
    return grid;
}

CFieldEdit* CBoneOffsetWindow::MakeRotation(int axis)
{
    auto* const field = new CFieldEdit(this);
    field->setObjectName(QStringLiteral("rotation") + AxisLetter(axis));
    field->setAccessibleName(tr("Rotation around %1 in degrees").arg(AxisLetter(axis)));
    field->setText(ToQString(dialog_.RotationText(axis)));
    field->setAlignment(Qt::AlignRight);
    field->SetOnLeave([=, this] { LeaveRotation(axis); });
    m_pkRotation[static_cast<size_t>(axis)] = field;
    return field;
}

QComboBox* CBoneOffsetWindow::MakeAxis(int axis)
{
    auto* const box = new QComboBox(this);
    box->setObjectName(QStringLiteral("axis") + AxisLetter(axis));
    box->setAccessibleName(tr("Source axis for %1").arg(AxisLetter(axis)));
    for (const std::string_view entry : CBoneOffsetDialog::kAxisEntries)
        box->addItem(ToQString(entry));
    connect(box, &QComboBox::activated, this, [=, this](int entry) {
        dialog_.ChooseAxis(axis, entry);
        ShowAxes();
    });
    m_pkAxis[static_cast<size_t>(axis)] = box;
    return box;
}

QLayout* CBoneOffsetWindow::MakeButtons()
{
    auto* const ok = new QPushButton(tr("OK"), this);
    ok->setObjectName(QStringLiteral("ok"));
    ok->setDefault(true);
    connect(ok, &QPushButton::clicked, this, [this] { accept(); });
    auto* const cancel = new QPushButton(tr("Cancel"), this);
    cancel->setObjectName(QStringLiteral("cancel"));
    cancel->setAutoDefault(false);
    connect(cancel, &QPushButton::clicked, this, [this] { reject(); });
    auto* const row = new QHBoxLayout;
    row->addStretch();
    row->addWidget(ok);
    row->addWidget(cancel);
    return row;
}

// Enter presses OK even while a field is being edited.
void CBoneOffsetWindow::accept()
{
    for (int axis = 0; axis < kAxisCount; ++axis)
        LeaveRotation(axis);
    QDialog::accept();
}

// Updates only this field: another one may contain input that is not read yet.
void CBoneOffsetWindow::LeaveRotation(int axis)
{
    CFieldEdit* const field = m_pkRotation[static_cast<size_t>(axis)];
    dialog_.LeaveRotation(axis, ToUtf8(field->text()));
    field->ShowText(ToQString(dialog_.RotationText(axis)));
}

void CBoneOffsetWindow::ShowAxes()
{
    for (int axis = 0; axis < kAxisCount; ++axis)
        m_pkAxis[static_cast<size_t>(axis)]->setCurrentIndex(dialog_.AxisEntry(axis));
}

} // namespace gw
