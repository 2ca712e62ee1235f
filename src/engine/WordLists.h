#pragma once

#include "shell/ArticleModel.h"

#include <QHash>
#include <QList>
#include <QString>

#include <functional>
#include <optional>

namespace verbloom {

class WordStore;

/// One row of a word list: a token and its hidden alternatives.
struct WordRow
{
    QString Text;
    QString Alternatives;
    bool Blue = false;    ///< alternatives came from the word file
    bool Bold = false;    ///< a repeat of a word already listed
    bool Checked = false; ///< never set by the user; SaveData skips such rows
};

/// The two word lists of the suggestions window (0 title, 1 contents) with an index of the rows
/// by case-folded text, so the repeat search costs O(1) per token.
class WordLists final
{
public:
    /// Called after rows were appended or changed, so a view can refresh.
    std::function<void(int list, qsizetype firstRow, qsizetype lastRow)> RowsInserted;
    std::function<void(int list, qsizetype row)> RowChanged;
    std::function<void()> Reset;

    void Clear();
    qsizetype Count(int list) const;
    const WordRow &Row(int list, qsizetype index) const; ///< index from 0
    const QList<WordRow> &Rows(int list) const;

    /// Appends a row; returns its index (from 0). The setters below ignore an index out of range.
    qsizetype Append(int list, const QString &text);
    void SetAlternatives(int list, qsizetype index, const QString &alternatives);
    void SetBlue(int list, qsizetype index, bool blue);
    void SetBold(int list, qsizetype index, bool bold);
    void SetChecked(int list, qsizetype index, bool checked);

    /// The alternatives of the last row (list 0 rows, then list 1 rows) whose text equals the word
    /// ignoring case (compared lowered, as word files are named); empty when no row matches.
    /// The alternatives are the row's current ones, edits included.
    std::optional<QString> FindRepeat(const QString &word) const;

private:
    WordRow *MutableRow(int list, qsizetype index);
    /// Applies a change to an existing row and reports it; a row index out of range is ignored.
    void Change(int list, qsizetype index, const std::function<void(WordRow &)> &change);

    QList<WordRow> m_rows[2];
    QHash<QString, std::pair<int, qsizetype>> m_lastByFoldedText;
};

/// The caption of the row count under the lists: "Working with N Words".
QString TotalCaption(qsizetype rows);

/// What the suggestions window lends AddItems.
struct AddItemsHooks
{
    std::function<void(const QString &caption)> SetCaption;       ///< window caption
    std::function<void()> ProcessEvents;                           ///< at least once per token
    std::function<bool()> Manual;                                  ///< chkDontPrompt checked
    /// The online lookup for the new row (list, row from 1); FetchAlternatives with an empty suffix.
    std::function<QString(const QString &word, int list, qsizetype row)> Lookup;
    std::function<void(const QString &text)> SetTotal;             ///< lblTotal caption
};

/// Adds the row of one token and gathers its alternatives: word file (blue), else the last earlier
/// row of the same word, else the lookup; repeats are bold. Nothing happens while StopProcessing.
void AddItems(WordLists &lists, const QString &word, int list, const WordTestSettings &settings,
              const WordStore &store, const AddItemsHooks &hooks);

/// Writes the rows into the word files in order, skipping checked, bold and non-customizable rows.
/// Returns the number of files that could not be written.
qsizetype SaveData(const WordLists &lists, const WordTestSettings &settings, const WordStore &store);

} // namespace verbloom
