#include "OptionsMenu.h"

#include "CGaitConvertContent.h"

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
     &ConversionChoices::align   },
    {QT_TRANSLATE_NOOP("OptionsMenu", "Faithful hips, knees and feet"),
     QT_TRANSLATE_NOOP("OptionsMenu",
     "Matches the source's hip height and travel, scaled by leg length; knees bend "
                       "and feet turn as in the source, and planted feet do not slide"),
     &ConversionChoices::faithful},
};

void AddChoice(QMenu& menu, CGaitConvertContent& logic, const Choice& choice)
{
    QAction* const action = menu.addAction(QCoreApplication::translate("OptionsMenu", choice.text));
    action->setToolTip(QCoreApplication::translate("OptionsMenu", choice.tip));
    action->setCheckable(true);
    action->setChecked(logic.Choices().*choice.chosen);
    QObject::connect(action, &QAction::triggered, &menu, [&logic, chosen = choice.chosen](bool on) {
        ConversionChoices choices = logic.Choices();
        choices.*chosen = on;
        logic.SetChoices(choices);
    });
}

} // namespace

QMenu* MakeOptionsMenu(CGaitConvertContent& logic, QWidget* owner)
{
    auto* const menu = new QMenu(owner);
    menu->setAttribute(Qt::WA_DeleteOnClose);
    menu->setToolTipsVisible(true);
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
