#include "frmSuggestionsModel.h"

#include "WordLists.h"

#include <QBrush>
#include <QColor>

namespace verbloom {

namespace {

// Rows appended while the lists fill reach the view at most this often.
constexpr int FlushIntervalMs = 60;

} // namespace

WordListModel::WordListModel(const WordLists &lists, int list, QObject *parent)
    : QAbstractTableModel(parent)
    , m_lists(lists)
    , m_list(list)
{
    m_boldFont.setBold(true);
    m_flushTimer.setSingleShot(true);
    m_flushTimer.setInterval(FlushIntervalMs);
    connect(&m_flushTimer, &QTimer::timeout, this, &WordListModel::Flush);
}

int WordListModel::rowCount(const QModelIndex &parent) const
{
    return parent.isValid() ? 0 : static_cast<int>(m_shown);
}

int WordListModel::columnCount(const QModelIndex &parent) const
{
    return parent.isValid() ? 0 : ColumnCount;
}

QVariant WordListModel::data(const QModelIndex &index, int role) const
{
    if (!index.isValid() || index.row() >= m_shown || index.row() >= m_lists.Count(m_list))
        return {};
    const WordRow &row = m_lists.Row(m_list, index.row());
    switch (role) {
    case Qt::ToolTipRole:
        return index.column() == ColumnWord && !row.Alternatives.isEmpty() ? QVariant(row.Alternatives)
                                                                           : QVariant();
    case Qt::DisplayRole:
        if (index.column() == ColumnWord)
            return row.Text;
        if (index.column() == ColumnSuggestions)
            return row.Alternatives;
        return {};
    case Qt::ForegroundRole:
        return row.Blue ? QVariant(QBrush(QColor(0, 0, 255))) : QVariant();
    case Qt::FontRole:
        return row.Bold ? QVariant(m_boldFont) : QVariant();
    default:
        return {};
    }
}

QVariant WordListModel::headerData(int section, Qt::Orientation orientation, int role) const
{
    if (orientation != Qt::Horizontal || role != Qt::DisplayRole)
        return QAbstractTableModel::headerData(section, orientation, role);
    switch (section) {
    case ColumnWord: return QStringLiteral("Alternate Word");
    case ColumnSuggestions: return QStringLiteral("Suggestions");
    case ColumnSimilar: return QStringLiteral("Similar Items");
    default: return {};
    }
}

void WordListModel::RowsAppended()
{
    if (!m_flushTimer.isActive())
        m_flushTimer.start();
}

void WordListModel::RowChanged(qsizetype row)
{
    if (row < 0 || row >= m_shown)
        return;
    const int r = static_cast<int>(row);
    emit dataChanged(index(r, 0), index(r, ColumnCount - 1));
}

void WordListModel::ListsReset()
{
    m_flushTimer.stop();
    beginResetModel();
    m_shown = m_lists.Count(m_list);
    endResetModel();
}

void WordListModel::Flush()
{
    m_flushTimer.stop();
    const qsizetype count = m_lists.Count(m_list);
    if (count <= m_shown)
        return;
    beginInsertRows(QModelIndex(), static_cast<int>(m_shown), static_cast<int>(count - 1));
    m_shown = count;
    endInsertRows();
}

} // namespace verbloom
