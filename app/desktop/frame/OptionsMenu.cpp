#include "OptionsMenu.h"

#include "CGaitConvertContent.h"
#include "QtText.h"
#include "Text.h"

#include <QActionGroup>
#include <QCoreApplication>

namespace gw {

namespace {

struct Choice
{
    const char* text;
    const char* tip;
    bool ConversionChoices::*chosen;
};

constexpr Choice kChoices[] = {
    {QT_TRANSLATE_NOOP("OptionsMenu", "Align the rest pose"),
     QT_TRANSLATE_NOOP("OptionsMenu",
     "Re-expresses the source relative to a T-pose first: for A-poses, arms down, "
                       "rotated bone frames, and positions that repeat the offsets"),
     &ConversionChoices::align    },
    {QT_TRANSLATE_NOOP("OptionsMenu", "Faithful hips, knees and feet"),
     QT_TRANSLATE_NOOP("OptionsMenu",
     "Matches the source's hip height and travel, scaled by leg length; knees bend "
                       "and feet turn as in the source, and planted feet do not slide"),
     &ConversionChoices::faithful },
    {QT_TRANSLATE_NOOP("OptionsMenu", "Hands follow what they touch"),
     QT_TRANSLATE_NOOP("OptionsMenu",
     "A hand that touches the trunk, the head, the other hand or the floor does so in "
                       "the result too; part of a faithful conversion"),
     &ConversionChoices::holdHands},
};

void AddChoice(QMenu& menu, CGaitConvertContent& logic, const Choice& choice)
{
    QAction* const action = menu.addAction(QCoreApplication::translate("OptionsMenu", choice.text));
    action->setToolTip(QCoreApplication::translate("OptionsMenu", choice.tip));
    action->setCheckable(true);
    action->setChecked(logic.Choices().*choice.chosen);
    action->setEnabled(choice.chosen != &ConversionChoices::holdHands || logic.Choices().faithful);
    QObject::connect(action, &QAction::triggered, &menu, [&logic, chosen = choice.chosen](bool on) {
        ConversionChoices choices = logic.Choices();
        choices.*chosen = on;
        logic.SetChoices(choices);
    });
}

void AddClips(QMenu& menu, CGaitConvertContent& logic)
{
    if (logic.Clips().size() < 2)
        return;
    QMenu* const clips = menu.addMenu(QCoreApplication::translate("OptionsMenu", "Clip"));
    auto* const group = new QActionGroup(clips);
    for (const std::string& clip : logic.Clips())
    {
        QAction* const action =
            clips->addAction(ToQString(Printable(clip)).replace(QLatin1Char('&'), QStringLiteral("&&")));
        action->setCheckable(true);
        action->setChecked(clip == logic.OpenClip());
        action->setActionGroup(group);
        QObject::connect(action, &QAction::triggered, &menu, [&logic, clip] { logic.ChooseClip(clip); });
    }
    menu.addSeparator();
}

} // namespace

QMenu* MakeOptionsMenu(CGaitConvertContent& logic, QWidget* owner)
{
    auto* const menu = new QMenu(owner);
    menu->setAttribute(Qt::WA_DeleteOnClose);
    menu->setToolTipsVisible(true);
    AddClips(*menu, logic);
    for (const Choice& choice : kChoices)
        AddChoice(*menu, logic, choice);
    menu->addSeparator();
    QAction* const draft =
        menu->addAction(QCoreApplication::translate("OptionsMenu", "Draft a bone map for this source"));
    draft->setToolTip(QCoreApplication::translate(
        "OptionsMenu", "Finds joints by name, or else by shape; opens the result in the editor"));
    draft->setEnabled(logic.SourceRoot() != nullptr);
    QObject::connect(draft, &QAction::triggered, menu, [&logic] { logic.DraftProfile(); });
    return menu;
}

} // namespace gw
