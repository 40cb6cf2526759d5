#include "AboutBox.h"

#include "QtText.h"
#include "StringTable.h"

#include <QDialog>
#include <QDialogButtonBox>
#include <QLabel>
#include <QVBoxLayout>

namespace gw {

namespace {

constexpr int kAboutMargin = 24;
constexpr int kAboutGap = 8;

} // namespace

void ShowAboutBox(QWidget& owner)
{
    QDialog box(&owner);
    box.setObjectName(QStringLiteral("100"));
    box.setWindowTitle(owner.windowTitle());
    auto* const name = new QLabel(owner.windowTitle(), &box);
    name->setObjectName(QStringLiteral("name"));
    name->setProperty("kind", QStringLiteral("text"));
    auto* const version = new QLabel(ToQString(BuiltInString(kTitleMessage)), &box);
    version->setObjectName(QStringLiteral("version"));
    auto* const buttons = new QDialogButtonBox(QDialogButtonBox::Ok, &box);
    buttons->setObjectName(QStringLiteral("buttons"));
    QObject::connect(buttons, &QDialogButtonBox::accepted, &box, &QDialog::accept);
    auto* const layout = new QVBoxLayout(&box);
    layout->setContentsMargins(kAboutMargin, kAboutMargin, kAboutMargin, kAboutMargin);
    layout->setSpacing(kAboutGap);
    layout->addWidget(name);
    layout->addWidget(version);
    layout->addWidget(buttons);
    box.exec();
}

} // namespace gw
