// The dialog of a map line. A table describes the fields of each kind of line.

#include "CMapLineDialog.h"

#include "ProfileFile.h"
#include "QtText.h"

#include <QCoreApplication>
#include <QDialogButtonBox>
#include <QFormLayout>
#include <QLabel>
#include <QLineEdit>
#include <QSpinBox>
#include <algorithm>
#include <iterator>
#include <limits>
#include <utility>

namespace gw {

namespace {

constexpr int kFieldWidth = 220;

// The dialog of a kind of line: its number, which never changes, its title and its fields.
struct Template
{
    EMapLine m_eKind;
    int m_iID;
    const char* m_pcTitle;
    const char* m_pcWhat;
};

constexpr Template kTemplates[] = {
    {EMapLine::Mapping,   158, QT_TRANSLATE_NOOP("GaitTool", "Rotation"),
     QT_TRANSLATE_NOOP("GaitTool", "Degrees around each axis")  },
    {EMapLine::Position,  159, QT_TRANSLATE_NOOP("GaitTool", "Position"),
     QT_TRANSLATE_NOOP("GaitTool", "Start position of the root")},
    {EMapLine::FrameRate, 160, QT_TRANSLATE_NOOP("GaitTool", "Frame Rate"),
     QT_TRANSLATE_NOOP("GaitTool", "Frames per second")         },
    {EMapLine::Fixed,     161, QT_TRANSLATE_NOOP("GaitTool", "Name"),
     QT_TRANSLATE_NOOP("GaitTool", "Text of the line")          },
    {EMapLine::Text,      161, QT_TRANSLATE_NOOP("GaitTool", "Name"),
     QT_TRANSLATE_NOOP("GaitTool", "Text of the line")          },
};

constexpr const char* kAxisNames[] = {"X", "Y", "Z"};
constexpr float Vec3::*kAxes[] = {&Vec3::x, &Vec3::y, &Vec3::z};

QString LineText(const char* text)
{
    return QCoreApplication::translate("GaitTool", text);
}

} // namespace

CMapLineDialog::CMapLineDialog(const MapLine& line, QWidget* owner) : QDialog(owner), m_kLine(line)
{
    setLocale(QLocale::c());
    const auto* const made = std::ranges::find(kTemplates, line.kind, &Template::m_eKind);
    setObjectName(QString::number(made->m_iID));
    setWindowTitle(LineText(made->m_pcTitle));
    auto* const what = new QLabel(LineText(made->m_pcWhat), this);
    what->setObjectName(QStringLiteral("what"));
    what->setProperty("kind", QStringLiteral("caption"));
    auto* const form = new QFormLayout(this);
    form->setSizeConstraint(QLayout::SetFixedSize);
    form->addRow(what);
    AddFields(*form);
    auto* const buttons = new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this);
    buttons->setObjectName(QStringLiteral("buttons"));
    connect(buttons, &QDialogButtonBox::accepted, this, &QDialog::accept);
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    form->addRow(buttons);
}

void CMapLineDialog::AddFields(QFormLayout& form)
{
    switch (m_kLine.kind)
    {
    case EMapLine::Mapping:
    case EMapLine::Position:
        AddNumbers(form);
        break;
    case EMapLine::FrameRate:
        AddNumber(form, windowTitle(), m_kLine.frameRate,
                  [](MapLine& line, int rate) { line.frameRate = rate; });
        break;
    case EMapLine::Fixed:
    case EMapLine::Text:
        AddText(form);
        break;
    }
}

void CMapLineDialog::AddNumbers(QFormLayout& form)
{
    for (size_t i = 0; i < std::size(kAxes); ++i)
    {
        const auto store = [axis = kAxes[i]](MapLine& line, int value) {
            line.numbers.*axis = static_cast<float>(value);
        };
        AddNumber(form, QString::fromLatin1(kAxisNames[i]), CutToInteger(m_kLine.numbers.*kAxes[i]), store);
    }
}

void CMapLineDialog::AddNumber(QFormLayout& form, const QString& label, int value,
                               std::function<void(MapLine&, int)> store)
{
    auto* const field = new QSpinBox(this);
    field->setObjectName(label);
    field->setAccessibleName(label);
    field->setButtonSymbols(QAbstractSpinBox::NoButtons);
    // Any value in a line can be shown.
    field->setRange(std::numeric_limits<int>::min(), std::numeric_limits<int>::max());
    field->setValue(value);
    field->setFixedWidth(kFieldWidth);
    if (form.rowCount() == 1) // the first field gets the keyboard
        field->selectAll();
    form.addRow(label, field);
    m_kStore.emplace_back([field, store = std::move(store)](MapLine& line) { store(line, field->value()); });
}

void CMapLineDialog::AddText(QFormLayout& form)
{
    auto* const field = new QLineEdit(ToQString(m_kLine.text), this);
    field->setObjectName(QStringLiteral("text"));
    field->setAccessibleName(windowTitle());
    field->setFixedWidth(kFieldWidth);
    field->selectAll();
    form.addRow(windowTitle(), field);
    m_kStore.emplace_back([field](MapLine& line) { line.text = ToUtf8(field->text()); });
}

MapLine CMapLineDialog::Line() const
{
    MapLine line = m_kLine;
    for (const auto& store : m_kStore)
        store(line);
    return line;
}

} // namespace gw
