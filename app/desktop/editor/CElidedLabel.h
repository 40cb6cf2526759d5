#pragma once

#include <QLabel>

namespace gw {

/// A label of one line that takes the room there is. A longer text is shortened in its middle, and stands
/// whole in the tool tip.
class CElidedLabel : public QLabel
{
public:
    explicit CElidedLabel(QWidget* parent);

    void ShowText(const QString& text);

protected:
    void resizeEvent(QResizeEvent* event) override;

private:
    void Fit();

    QString m_kText;
};

} // namespace gw
