#pragma once

#include "CContentWindow.h"

#include <QFileDialog>
#include <optional>
#include <string>

namespace gw {

/// Runs the toolkit's own file dialog over a window. None when it was cancelled.
std::optional<std::string> RunFileDialog(QWidget& owner, QFileDialog::AcceptMode mode,
                                         const CFileDialogSetup& setup);

/// The entries of a setup's filter as the toolkit wants them: the text as it stands, and behind it the
/// patterns in brackets, which the dialog hides.
QStringList NameFilters(const std::string& filter);

} // namespace gw
