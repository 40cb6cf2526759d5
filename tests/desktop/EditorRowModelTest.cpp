// A list that only receives changes shows the same as the table.
#include "CMapRowModel.h"

#include <QAbstractItemModelTester>
#include <gtest/gtest.h>
#include <random>

namespace gw {
namespace {

// Returns the texts of a row's columns, each followed by a bar.
template <class F>
std::string RowText(F textOf)
{
    std::string text;
    for (int column = 0; column < kMapColumnCount; ++column)
        text += textOf(column) + '|';
    return text;
}

/// Keeps a copy of a model's rows like a view: by its change notifications only.
class CMirror
{
public:
    explicit CMirror(const CMapRowModel& model) : model_(model)
    {
        QObject::connect(&model, &QAbstractItemModel::rowsInserted, &model,
                         [this](const QModelIndex&, int first, int last) {
                             m_kRows.insert(m_kRows.begin() + first,
                                            static_cast<size_t>(last) - static_cast<size_t>(first) + 1, {});
                             Take(first, last);
                         });
        QObject::connect(&model, &QAbstractItemModel::rowsRemoved, &model,
                         [this](const QModelIndex&, int first, int last) {
                             m_kRows.erase(m_kRows.begin() + first, m_kRows.begin() + last + 1);
                         });
        QObject::connect(
            &model, &QAbstractItemModel::dataChanged, &model,
            [this](const QModelIndex& first, const QModelIndex& last) { Take(first.row(), last.row()); });
    }

    const std::vector<std::string>& Rows() const { return m_kRows; }

private:
    void Take(int first, int last)
    {
        for (int row = first; row <= last; ++row)
            m_kRows[size_t(row)] = RowText(
                [&](int column) { return model_.index(row, column).data().toString().toStdString(); });
    }

    const CMapRowModel& model_;
    std::vector<std::string> m_kRows;
};

std::vector<std::string> RowsOf(const CMapRowTable& table)
{
    std::vector<std::string> rows;
    rows.reserve(static_cast<size_t>(table.RowCount()));
    for (int row = 0; row < table.RowCount(); ++row)
        rows.push_back(RowText([&](int column) { return table.Text(row, column); }));
    return rows;
}

} // namespace

TEST(EditorRowModel, EveryChangeIsTold)
{
    CMapRowModel model({}, nullptr);
    const QAbstractItemModelTester tester(&model, QAbstractItemModelTester::FailureReportingMode::Fatal);
    const CMirror mirror(model);
    CMapRowTable table;
    std::mt19937 random(7); // the same changes on every run
    const auto below = [&](int end) { return static_cast<int>(random() % static_cast<unsigned>(end)); };
    for (int step = 0; step < 500; ++step)
    {
        for (int change = below(4); change >= 0; --change)
        {
            RowNumbers numbers;
            numbers.rotation[1] = below(3);
            if (below(3) == 0)
                table.RemoveRow(below(20));
            else
                table.AddRow("s", std::string("t").append(std::to_string(below(20))), numbers,
                             ERowColumns::All);
        }
        if (below(50) == 0)
            table.Clear();
        model.ShowRows(table);
        ASSERT_EQ(mirror.Rows(), RowsOf(table)) << "step " << step;
    }
}

} // namespace gw
