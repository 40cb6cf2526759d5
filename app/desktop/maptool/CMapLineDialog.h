#pragma once

#include "MapLines.h"

#include <QDialog>
#include <functional>
#include <vector>

class QFormLayout;

namespace gw {

/// Edits one map line: a mapping's rotation, the position, the frame rate, or a text, as its kind asks for.
class CMapLineDialog : public QDialog
{
public:
    CMapLineDialog(const CMapLine& line, QWidget* owner);

    /// The line with what the fields hold.
    CMapLine Line() const;

private:
    void AddFields(QFormLayout& form);
    void AddNumbers(QFormLayout& form);
    void AddNumber(QFormLayout& form, const QString& label, int value,
                   std::function<void(CMapLine&, int)> store);
    void AddText(QFormLayout& form);

    CMapLine m_kLine;
    std::vector<std::function<void(CMapLine&)>> m_kStore; // one a field
};

} // namespace gw
