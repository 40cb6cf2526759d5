#include "EditorFixture.h"

#include "QtText.h"

#include <QApplication>
#include <QTest>

namespace gw {

void Settle()
{
    QApplication::processEvents();
    QApplication::processEvents(); // handles events queued in the meantime
}

EditorTest::EditorTest()
{
    m_kWindow.onShowEditor = [this](bool shown) { m_kEditor.SetShown(shown); };
    m_kWindow.onRefreshEditor = [this] { m_kEditor.Refresh(); };
    m_kWindow.onBoneOffset = [this](CBoneOffsetDialog& dialog) { return m_kEditor.RunBoneOffset(dialog); };
}

// Queued events run while everything still exists.
EditorTest::~EditorTest()
{
    Settle();
}

void EditorTest::OpenEditor()
{
    Open(Write("walk.bvh", BvhText(kPoserBones)));
    Toggle(true);
    Activate(m_kEditor);
    m_kWindow.TakeCalls();
}

void EditorTest::Toggle(bool shown)
{
    m_kWindow.m_bButtonState = shown;
    m_kContent.ChildClick("%adv");
    Settle();
}

void EditorTest::Type(int field, const char* text)
{
    Activate(m_kEditor);
    TypeInto(Child<QLineEdit>(field), QString::fromUtf8(text));
}

void EditorTest::Press(Qt::Key key, Qt::KeyboardModifiers modifiers)
{
    Activate(m_kEditor);
    QTest::keyClick(QApplication::focusWidget(), key, modifiers);
    Settle();
}

void EditorTest::Click(int button)
{
    QTest::mouseClick(&Child<QPushButton>(button), Qt::LeftButton);
    Settle();
}

void EditorTest::ClickBone(int tree, const std::string& name)
{
    auto& view = Child<CBoneTreeView>(tree);
    ClickItem(view, ItemOf(view, name));
    Settle();
}

void EditorTest::ClickRow(int row, Qt::KeyboardModifiers modifiers)
{
    auto& view = Child<CMapRowView>(kMapRowList);
    ClickItem(view, view.model()->index(row, 0), modifiers);
    Settle();
}

void EditorTest::DoubleClickRow(int row)
{
    auto& view = Child<CMapRowView>(kMapRowList);
    const QModelIndex index = view.model()->index(row, 0);
    ClickItem(view, index);
    QTest::mouseDClick(view.viewport(), Qt::LeftButton, {}, view.visualRect(index).center());
    Settle();
}

void EditorTest::InOffsetDialog(const std::function<void(QWidget& dialog)>& actions)
{
    m_kAnswers.Add([actions](QWidget& dialog) {
        actions(dialog);
        EXPECT_FALSE(dialog.isVisible()) << "the person has to end it";
        dialog.close();
        return true;
    });
}

std::string EditorTest::Field(int field) const
{
    return ToUtf8(Child<QLineEdit>(field).text());
}

bool EditorTest::IsEnabled(int button) const
{
    return Child<QPushButton>(button).isEnabled();
}

std::vector<std::string> EditorTest::Bones(int tree) const
{
    auto& view = Child<CBoneTreeView>(tree);
    std::vector<std::string> names;
    for (auto* item = view.topLevelItem(0); item; item = view.itemBelow(item))
        names.push_back(ToUtf8(item->text(0)));
    return names;
}

std::string EditorTest::SelectedBone(int tree) const
{
    const auto selected = Child<CBoneTreeView>(tree).selectedItems();
    return selected.isEmpty() ? std::string() : ToUtf8(selected[0]->text(0));
}

std::vector<std::string> EditorTest::Rows() const
{
    const QAbstractItemModel& model = *Child<CMapRowView>(kMapRowList).model();
    std::vector<std::string> rows;
    for (int row = 0; row < model.rowCount(); ++row)
    {
        const auto text = [&](int column) { return ToUtf8(model.index(row, column).data().toString()); };
        std::string all = text(kSourceColumn) + " > " + text(kTargetColumn);
        for (int column = kRotationColumn; column < model.columnCount(); ++column)
            all += text(column).empty() ? "" : ' ' + text(column);
        rows.push_back(all);
    }
    return rows;
}

std::vector<int> EditorTest::SelectedRows() const
{
    std::vector<int> rows;
    for (const QModelIndex& index : Child<CMapRowView>(kMapRowList).selectionModel()->selectedRows())
        rows.push_back(index.row());
    return rows;
}

} // namespace gw
