#pragma once

#include "MapLines.h"

#include <QDialog>
#include <functional>
#include <vector>

class QFormLayout;

namespace gw {

/// Edits one map line: a mapping's rotation, the position, the frame rate, or a text, depending on its kind.
class CMapLineDialog : public QDialog
{
public:
    CMapLineDialog(const MapLine& line, QWidget* owner);

    /// Returns the line with the values of the fields.
    MapLine Line() const;

private:
    void AddFields(QFormLayout& form);
    void AddNumbers(QFormLayout& form);
    void AddNumber(QFormLayout& form, const QString& label, int value,
                   std::function<void(MapLine&, int)> store);
    void AddText(QFormLayout& form);

    MapLine m_kLine;
    std::vector<std::function<void(MapLine&)>> m_kStore; // one per field
};

} // namespace gw
