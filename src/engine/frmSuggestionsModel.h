#pragma once

#include <QAbstractTableModel>
#include <QFont>
#include <QTimer>

namespace verbloom {

class WordLists;

/// One word list of the suggestions window as a table: "Alternate Word", "Suggestions" (the hidden
/// alternatives) and "Similar Items". Blue rows get a blue fore colour, bold rows a bold font.
/// Appended rows reach the view in batches: Flush() shows them at once, otherwise a short timer does.
/// A part of the suggestions window (it uses QtGui types), built with the windows only.
class WordListModel final : public QAbstractTableModel
{
    Q_OBJECT

public:
    enum Column { ColumnWord = 0, ColumnSuggestions = 1, ColumnSimilar = 2, ColumnCount = 3 };

    WordListModel(const WordLists &lists, int list, QObject *parent = nullptr);

    int rowCount(const QModelIndex &parent = QModelIndex()) const override;
    int columnCount(const QModelIndex &parent = QModelIndex()) const override;
    QVariant data(const QModelIndex &index, int role = Qt::DisplayRole) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;

    /// The lists grew: the new rows are shown with the next batch.
    void RowsAppended();
    void RowChanged(qsizetype row);
    void ListsReset();
    /// Shows every row the lists hold now.
    void Flush();

private:
    const WordLists &m_lists;
    const int m_list;
    qsizetype m_shown = 0;
    QTimer m_flushTimer;
    QFont m_boldFont;
};

} // namespace verbloom
