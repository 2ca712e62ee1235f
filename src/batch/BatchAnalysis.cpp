#include "batch/BatchAnalysis.h"

#include "batch/BatchConsole.h"
#include "engine/WordStore.h"

#include <QSet>

namespace verbloom {

BatchAnalysis::BatchAnalysis(const WordTestSettings &settings, const WordStore &store,
                             const LookupContext &lookup, BatchConsole &console)
    : m_settings(settings)
    , m_store(store)
    , m_lookup(lookup)
    , m_console(console)
{
    m_lookup.Manual = true;
    m_lookup.Article = &m_article;
    m_lookup.Confirm = nullptr;
    m_hooks.Manual = [] { return true; };
    if (m_lookup.Page && !m_lookup.Host.isEmpty()) {
        m_hooks.Lookup = [this](const QString &word, int list, qsizetype row) {
            return FetchAlternatives(word, QString(), list, row, m_lookup);
        };
    }
}

void BatchAnalysis::Run(const QString &title, const QString &contents)
{
    StopProcessing = false;
    m_inContents = false;
    FillWordLists(title, contents, m_article, *this, *this);
}

QStringList BatchAnalysis::NewWords() const
{
    QStringList words;
    QSet<QString> seen;
    for (int list = 0; list < 2; ++list) {
        for (const WordRow &row : m_lists.Rows(list)) {
            if (row.Blue || !IsCustomizableWord(row.Text, m_settings))
                continue;
            const QString key = row.Text.toLower();
            if (seen.contains(key))
                continue;
            seen.insert(key);
            words.append(row.Text);
        }
    }
    return words;
}

qsizetype BatchAnalysis::SaveWordFiles() const
{
    return SaveData(m_lists, m_settings, m_store);
}

void BatchAnalysis::ClearLists()
{
    m_lists.Clear();
}

void BatchAnalysis::SetProgressMaximum(qsizetype maximum)
{
    m_progressMaximum = maximum;
}

void BatchAnalysis::SetProgressValue(qsizetype value)
{
    m_console.Progress(m_inContents ? u"Analysing the contents"_qs : u"Analysing the title"_qs, value,
                       m_progressMaximum);
}

void BatchAnalysis::SelectContentsTab()
{
    m_inContents = true;
}

void BatchAnalysis::AddItems(const QString &word, int list)
{
    verbloom::AddItems(m_lists, word, list, m_settings, m_store, m_hooks);
}

} // namespace verbloom
