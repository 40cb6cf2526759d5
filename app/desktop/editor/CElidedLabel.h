#pragma once

#include <QLabel>

namespace gw {

/// A single-line label that uses the available width. A longer text is elided in the middle and shown in full
/// in the tool tip.
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
