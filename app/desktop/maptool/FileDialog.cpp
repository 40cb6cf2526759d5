#include "FileDialog.h"

#include "QtText.h"

namespace gw {

QStringList NameFilters(const std::string& filter)
{
    const QStringList parts = ToQString(filter).split(u'|', Qt::SkipEmptyParts);
    QStringList filters;
    for (qsizetype i = 0; i + 1 < parts.size(); i += 2)
    {
        const QString patterns = parts[i + 1].split(u';', Qt::SkipEmptyParts).join(u' ');
        filters << parts[i] + u'(' + patterns + u')';
    }
    return filters;
}

std::optional<std::string> RunFileDialog(QWidget& owner, QFileDialog::AcceptMode mode,
                                         const CFileDialogSetup& setup)
{
    QFileDialog dialog(&owner);
    dialog.setOptions(QFileDialog::DontUseNativeDialog | QFileDialog::HideNameFilterDetails);
    dialog.setAcceptMode(mode);
    dialog.setFileMode(mode == QFileDialog::AcceptOpen ? QFileDialog::ExistingFile : QFileDialog::AnyFile);
    dialog.setDefaultSuffix(ToQString(setup.defaultExtension));
    dialog.setNameFilters(NameFilters(setup.filter));
    if (!setup.initialFolder.empty())
        dialog.setDirectory(ToQString(setup.initialFolder));
    if (dialog.exec() != QDialog::Accepted || dialog.selectedFiles().isEmpty())
        return std::nullopt;
    return ToUtf8(dialog.selectedFiles().first());
}

} // namespace gw
