#pragma once

#include "CContentWindow.h"

#include <QFileDialog>
#include <optional>
#include <string>

namespace gw {

/// Runs the toolkit's own file dialog over a window. None when it was cancelled.
std::optional<std::string> RunFileDialog(QWidget& owner, QFileDialog::AcceptMode mode,
                                         const FileDialogSetup& setup);

} // namespace gw
