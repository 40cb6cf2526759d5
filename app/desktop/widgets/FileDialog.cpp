#include "FileDialog.h"

#include "FileFilter.h"
#include "QtText.h"

#include <QDir>
#include <QFileInfo>

namespace gw {

namespace {

// The text followed by the patterns in brackets, which the dialog hides.
QStringList NameFilters(const std::string& filter)
{
    QStringList names;
    for (const FileFilter& choice : SplitFilter(filter))
    {
        QStringList patterns;
        for (const std::string& pattern : choice.patterns)
            patterns << ToQString(pattern);
        names << ToQString(choice.text) + QLatin1Char('(') + patterns.join(QLatin1Char(' ')) +
                     QLatin1Char(')');
    }
    return names;
}

void SelectFilter(QFileDialog& dialog, const std::string& path)
{
    const QString name = QFileInfo(ToQString(path)).fileName();
    for (const QString& filter : dialog.nameFilters())
    {
        const QString patterns = filter.section(QLatin1Char('('), -1).chopped(1);
        if (!path.empty() && QDir::match(patterns.split(QLatin1Char(' ')).join(QLatin1Char(';')), name))
            return dialog.selectNameFilter(filter);
    }
}

} // namespace

std::optional<std::string> RunFileDialog(QWidget& owner, QFileDialog::AcceptMode mode,
                                         const FileDialogSetup& setup)
{
    QFileDialog dialog(&owner);
    dialog.setOptions(QFileDialog::DontUseNativeDialog | QFileDialog::HideNameFilterDetails);
    dialog.setAcceptMode(mode);
    dialog.setFileMode(mode == QFileDialog::AcceptOpen ? QFileDialog::ExistingFile : QFileDialog::AnyFile);
    dialog.setDefaultSuffix(ToQString(setup.defaultExtension));
    dialog.setNameFilters(NameFilters(setup.filter) + NameFilters(setup.moreFilters));
    SelectFilter(dialog, setup.openedLast);
    if (!setup.initialFolder.empty())
        dialog.setDirectory(ToQString(setup.initialFolder));
    if (!setup.fileName.empty())
        dialog.selectFile(ToQString(setup.fileName));
    if (dialog.exec() != QDialog::Accepted || dialog.selectedFiles().isEmpty())
        return std::nullopt;
    return ToUtf8(dialog.selectedFiles().first());
}

} // namespace gw
