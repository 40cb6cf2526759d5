#include "DesktopArguments.h"

#include "QtText.h"

#include <QFileInfo>

namespace gw {

namespace {

bool IsFlag(const QString& argument)
{
    return argument.startsWith(QLatin1Char('-')) ||
           (argument.startsWith(QLatin1Char('/')) && !QFileInfo::exists(argument));
}

// A lowercase s as the first letter selects the tool, or an uppercase one as the second. That "-S" alone does
// not is how the flag has always been read.
bool IsToolFlag(const QString& flag)
{
    return flag.startsWith(QLatin1Char('s')) || (flag.size() > 1 && flag[1] == QLatin1Char('S'));
}

} // namespace

DesktopArguments ReadArguments(const QStringList& arguments)
{
    DesktopArguments read;
    for (const QString& argument : arguments)
    {
        if (argument == QLatin1String("--reset-instance-counter"))
            read.resetCounter = true;
        else if (argument == QLatin1String("--help") || argument == QLatin1String("-h"))
            read.help = true;
        else if (IsFlag(argument))
            read.mapTool = read.mapTool || IsToolFlag(argument.mid(1));
        else if (read.file.empty())
            read.file = ToUtf8(QFileInfo(argument).absoluteFilePath());
    }
    return read;
}

} // namespace gw
