#pragma once

#include <QMenu>

namespace gw {

class CGaitConvertContent;

/// Creates the menu of conversion options, with a check mark for each one in use. It deletes itself when
/// closed; the conversion must outlive it.
QMenu* MakeOptionsMenu(CGaitConvertContent& logic, QWidget* owner);

} // namespace gw
