#pragma once

#include <QAbstractItemView>
#include <QLineEdit>
#include <QWidget>
#include <gtest/gtest.h>
#include <string>

namespace gw {

/// Returns a child widget by name; fails the test if it does not exist.
template <class Widget = QWidget>
Widget& ChildOf(const QWidget& parent, const QString& name)
{
    auto* const child = parent.findChild<Widget*>(name);
    EXPECT_TRUE(child) << name.toStdString();
    return *child;
}

/// Clicks an entry of a list or tree.
void ClickItem(QAbstractItemView& view, const QModelIndex& item, Qt::KeyboardModifiers modifiers = {});
/// Returns the entry of a tree with a text; fails the test if it does not exist.
QModelIndex ItemOf(const QAbstractItemView& view, const std::string& text);
/// Replaces the text of a field with the keyboard.
void TypeInto(QLineEdit& field, const QString& text);
/// Enters a path in a file dialog and accepts it. Returns false for any other dialog.
bool ChooseFile(QWidget& dialog, const std::string& path);
/// Drags a file over a widget and drops it on another one; returns false if the first one does not take it.
bool DropFile(QWidget& over, QWidget& onto, const std::string& path);

} // namespace gw
