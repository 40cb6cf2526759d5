#include "Widgets.h"

#include "QtText.h"

#include <QApplication>
#include <QDropEvent>
#include <QFileDialog>
#include <QMimeData>
#include <QTest>
#include <QUrl>

namespace gw {

void ClickItem(QAbstractItemView& view, const QModelIndex& item, Qt::KeyboardModifiers modifiers)
{
    view.scrollTo(item);
    QTest::mouseClick(view.viewport(), Qt::LeftButton, modifiers, view.visualRect(item).center());
}

QModelIndex ItemOf(const QAbstractItemView& view, const std::string& text)
{
    const QModelIndexList found =
        view.model()->match(view.model()->index(0, 0), Qt::DisplayRole, ToQString(text), -1,
                            Qt::MatchExactly | Qt::MatchCaseSensitive | Qt::MatchRecursive);
    EXPECT_EQ(found.size(), 1) << text;
    return found.value(0);
}

void TypeInto(QLineEdit& field, const QString& text)
{
    field.setFocus();
    field.selectAll();
    QTest::keyClicks(&field, text);
    if (text.isEmpty())
        QTest::keyClick(&field, Qt::Key_Delete);
}

bool ChooseFile(QWidget& dialog, const std::string& path)
{
    auto* const files = dynamic_cast<QFileDialog*>(&dialog);
    if (!files)
        return false;
    ChildOf<QLineEdit>(*files, QStringLiteral("fileNameEdit")).setText(ToQString(path));
    return QMetaObject::invokeMethod(files, path.empty() ? "reject" : "accept");
}

bool DropFile(QWidget& over, QWidget& onto, const std::string& path)
{
    QMimeData mime;
    mime.setUrls({QUrl::fromLocalFile(ToQString(path))});
    QDragEnterEvent enter({5, 5}, Qt::CopyAction, &mime, Qt::LeftButton, {});
    enter.ignore();
    QApplication::sendEvent(&over, &enter);
    QDropEvent drop({5, 5}, Qt::CopyAction, &mime, Qt::LeftButton, {});
    return enter.isAccepted() && QApplication::sendEvent(&onto, &drop);
}

} // namespace gw
