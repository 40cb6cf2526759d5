#pragma once

#include <QMenu>

namespace gw {

class CGaitConvertContent;

/// The menu of what a conversion may do beside the rules, each with a mark where it is chosen. Deletes itself
/// when it is closed; the conversion must outlive it.
QMenu* MakeOptionsMenu(CGaitConvertContent& logic, QWidget* owner);

} // namespace gw
