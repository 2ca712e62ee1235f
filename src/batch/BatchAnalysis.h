#pragma once

#include "engine/ThesaurusLookup.h"
#include "engine/WordLists.h"
#include "shell/ArticleChecks.h"
#include "shell/ArticleModel.h"

#include <QString>
#include <QStringList>

#include <optional>

namespace verbloom {

class BatchConsole;
class WordStore;

/// The analysis of "Next" without windows: splits the article and adds one word row per token
/// with the word-file, earlier-row and lookup rules (lookups as with "Manual" checked).
class BatchAnalysis final : private SuggestionsView, private WizardHost
{
public:
    /// `lookup`: where lookups go; without a page source or host no word is looked up.
    BatchAnalysis(const WordTestSettings &settings, const WordStore &store, const LookupContext &lookup,
                  BatchConsole &console);

    /// Analyses the article (title and contents as "Next" leaves them).
    void Run(const QString &title, const QString &contents);

    const ArticleTokens &Article() const { return m_article; }
    const WordLists &Lists() const { return m_lists; }

    /// The customizable words that had no word file, title first, each once (ignoring case).
    QStringList NewWords() const;

    /// Writes the rows into the word files (SaveData); returns the number that could not be written.
    qsizetype SaveWordFiles() const;

private:
    // The suggestions window as FillWordLists drives it.
    void ShowModeless() override {}
    void ClearLists() override;
    void SetStatusVisible(bool) override {}
    void SetProgressMaximum(qsizetype maximum) override;
    void SetProgressValue(qsizetype value) override;
    void SetWordCaption(const QString &) override {}
    void SelectContentsTab() override;
    void AddItems(const QString &word, int list) override;
    void Unload() override {}
    // The main window in the cancel path, which a batch run never takes.
    void cmdNext_Click() override {}
    void SetButton(bool) override {}
    void UnloadWaitWindow() override {}
    void ShowMainWindow() override {}

    WordTestSettings m_settings;
    const WordStore &m_store;
    LookupContext m_lookup;
    BatchConsole &m_console;
    ArticleTokens m_article;
    WordLists m_lists;
    AddItemsHooks m_hooks;
    bool m_inContents = false;
    qsizetype m_progressMaximum = 0;
};

} // namespace verbloom
