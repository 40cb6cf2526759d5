#pragma once

#include "CContentWindow.h"

#include <QFileDialog>
#include <optional>
#include <string>

namespace gw {

/// Runs the toolkit's file dialog over a window. Returns nothing if it was canceled.
std::optional<std::string> RunFileDialog(QWidget& owner, QFileDialog::AcceptMode mode,
                                         const FileDialogSetup& setup);

} // namespace gw
