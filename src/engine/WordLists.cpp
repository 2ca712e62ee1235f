#include "WordLists.h"

#include "engine/WordStore.h"

namespace verbloom {

namespace {

// Words that differ only in capitals are repeats of each other, exactly as they share a word file.
QString RepeatKey(const QString &text)
{
    return text.toLower();
}

// Search order of the repeat search: all rows of list 0, then all rows of list 1.
bool ComesAfter(const std::pair<int, qsizetype> &a, const std::pair<int, qsizetype> &b)
{
    return a.first != b.first ? a.first > b.first : a.second > b.second;
}

int ListIndex(int list)
{
    Q_ASSERT(list == 0 || list == 1);
    return list == 0 ? 0 : 1;
}

} // namespace

void WordLists::Clear()
{
    m_rows[0].clear();
    m_rows[1].clear();
    m_lastByFoldedText.clear();
    if (Reset)
        Reset();
}

qsizetype WordLists::Count(int list) const
{
    return m_rows[ListIndex(list)].size();
}

const WordRow &WordLists::Row(int list, qsizetype index) const
{
    static const WordRow kNoRow;
    const QList<WordRow> &rows = m_rows[ListIndex(list)];
    Q_ASSERT(index >= 0 && index < rows.size());
    return index >= 0 && index < rows.size() ? rows.at(index) : kNoRow;
}

const QList<WordRow> &WordLists::Rows(int list) const
{
    return m_rows[ListIndex(list)];
}

qsizetype WordLists::Append(int list, const QString &text)
{
    const int l = ListIndex(list);
    WordRow row;
    row.Text = text;
    m_rows[l].append(row);
    const std::pair<int, qsizetype> position(l, m_rows[l].size() - 1);
    auto it = m_lastByFoldedText.find(RepeatKey(text));
    if (it == m_lastByFoldedText.end())
        m_lastByFoldedText.insert(RepeatKey(text), position);
    else if (ComesAfter(position, it.value()))
        it.value() = position;
    if (RowsInserted)
        RowsInserted(l, position.second, position.second);
    return position.second;
}

WordRow *WordLists::MutableRow(int list, qsizetype index)
{
    QList<WordRow> &rows = m_rows[ListIndex(list)];
    // A row may have gone while a lookup waited (the lists were cleared); the write is then dropped.
    return index >= 0 && index < rows.size() ? &rows[index] : nullptr;
}

void WordLists::Change(int list, qsizetype index, const std::function<void(WordRow &)> &change)
{
    if (WordRow *row = MutableRow(list, index)) {
        change(*row);
        if (RowChanged)
            RowChanged(ListIndex(list), index);
    }
}

void WordLists::SetAlternatives(int list, qsizetype index, const QString &alternatives)
{
    Change(list, index, [&](WordRow &row) { row.Alternatives = alternatives; });
}

void WordLists::SetBlue(int list, qsizetype index, bool blue)
{
    Change(list, index, [&](WordRow &row) { row.Blue = blue; });
}

void WordLists::SetBold(int list, qsizetype index, bool bold)
{
    Change(list, index, [&](WordRow &row) { row.Bold = bold; });
}

void WordLists::SetChecked(int list, qsizetype index, bool checked)
{
    Change(list, index, [&](WordRow &row) { row.Checked = checked; });
}

std::optional<QString> WordLists::FindRepeat(const QString &word) const
{
    const auto it = m_lastByFoldedText.constFind(RepeatKey(word));
    if (it == m_lastByFoldedText.constEnd())
        return std::nullopt;
    return m_rows[it->first].at(it->second).Alternatives;
}

QString TotalCaption(qsizetype rows)
{
    return QLatin1String("Working with ") + QString::number(rows) + QLatin1String(" Words");
}

void AddItems(WordLists &lists, const QString &word, int list, const WordTestSettings &settings,
              const WordStore &store, const AddItemsHooks &hooks)
{
    if (StopProcessing)
        return;
    if (hooks.SetCaption)
        hooks.SetCaption(QLatin1String("Getting alternatives for ") + word);
    if (hooks.ProcessEvents)
        hooks.ProcessEvents();
    const std::optional<QString> repeat = lists.FindRepeat(word);
    const qsizetype index = lists.Append(list, word);

    if (IsCustomizableWord(word, settings)) {
        if (store.WordFileExists(word, settings)) {
            lists.SetBlue(list, index, true);
            lists.SetAlternatives(list, index, store.ReadAlternatives(word));
        } else if (repeat) {
            lists.SetAlternatives(list, index, *repeat);
        } else {
            // "Manual" as it stood when the lookup began: ticking "Do not prompt again." in the
            // confirm window must not overwrite the choice that window has just written.
            const bool manual = hooks.Manual && hooks.Manual();
            const QString found = hooks.Lookup ? hooks.Lookup(word, list, index + 1) : QString();
            // Without "Manual" the confirm window has written the user's choice into the row.
            if (manual)
                lists.SetAlternatives(list, index, found);
        }
        if (repeat)
            lists.SetBold(list, index, true);
    }

    if (hooks.SetTotal)
        hooks.SetTotal(TotalCaption(lists.Count(list)));
}

qsizetype SaveData(const WordLists &lists, const WordTestSettings &settings, const WordStore &store)
{
    qsizetype failures = 0;
    for (int list = 0; list < 2; ++list) {
        for (const WordRow &row : lists.Rows(list)) {
            if (row.Checked || row.Bold || !IsCustomizableWord(row.Text, settings))
                continue;
            // A word that cannot be a file name simply has no file.
            if (store.GetWordFilePath(row.Text).isEmpty())
                continue;
            if (!store.WriteAlternatives(row.Text, row.Alternatives))
                ++failures;
        }
    }
    return failures;
}

} // namespace verbloom
