#pragma once

#include "CCntComboExControl.h"

#include <QPointer>
#include <QString>
#include <functional>

class QAbstractButton;
class QComboBox;

namespace gw {

/// The list of profiles, shown by two children of the face: the field with the selected profile and the arrow
/// that opens the list.
class CProfileCombo : public CProfileList
{
public:
    /// Notification code of a choice by the user.
    static constexpr int kChosen = 9;

    void AddItem(const std::string& text, int userData) override;
    void DeleteItem(int index) override;
    void SetCurSel(int index) override;
    void SetItemWords(int index, const std::string& words, const std::string& tip) override;

    void SetFont(const std::string& family, int fieldSize, int listSize) override;

    /// Both can be destroyed before this. The font size is in tenths of a point.
    void SetChildren(QComboBox* field, QAbstractButton* arrow, int fontSize);
    /// Called when the user has chosen a profile, after the selection.
    void SetNotify(std::function<void(int code)> notify) { notify_ = std::move(notify); }

private:
    void ShowSelection();
    void Choose(int index);

    QPointer<QComboBox> m_kField;
    QString m_kTip; // of the field if nothing is selected
    std::function<void(int)> notify_;
};

} // namespace gw
