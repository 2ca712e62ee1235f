#pragma once

#include "engine/ThesaurusLookup.h"
#include "engine/WordLists.h"
#include "engine/WordStore.h"
#include "shell/ArticleModel.h"

#include <QElapsedTimer>
#include <QWidget>

class QCheckBox;
class QLabel;
class QPlainTextEdit;
class QProgressBar;
class QTabWidget;
class QTableView;

namespace verbloom {

class ImageCommand;
class SuggestionsHost;
class UiServices;
class WordListModel;

/// The suggestions window: the word rows of the title and the contents, the alternatives of the
/// selected row, a live sample, and the progress of the analysis that fills it. Loaded once by
/// the main window and only hidden when closed.
class frmSuggestions final : public QWidget, public SuggestionsView, private ConfirmMeaningPresenter
{
    Q_OBJECT

public:
    frmSuggestions(SuggestionsHost &host, UiServices &ui, QWidget *parent = nullptr);
    ~frmSuggestions() override;

    // SuggestionsView
    void ShowModeless() override;
    void ClearLists() override;
    void SetStatusVisible(bool visible) override;
    void SetProgressMaximum(qsizetype maximum) override;
    void SetProgressValue(qsizetype value) override;
    void SetWordCaption(const QString &caption) override;
    void SelectContentsTab() override;
    /// Adds the row of one token (list 0 title, 1 contents) and gathers its alternatives.
    void AddItems(const QString &word, int list) override;
    /// Hides the window without the closing steps; its rows stay.
    void Unload() override;

    /// Writes the rows into the word files; returns the number of files that could not be written.
    qsizetype SaveData();
    /// Saves the rows and shows a new sample of the part whose tab is shown.
    void PopulateContent();

    /// The choice of the confirm-meaning window: selects the row (list, row from 1) by the hidden
    /// labels and puts the text into txtSuggestions, whose change stores it in that row.
    void TakeConfirmedChoice(const QString &list, const QString &item, const QString &alternatives);
    /// Checks "Manual", so later lookups take the last meaning without asking.
    void CheckManual();

    const WordLists &Lists() const { return m_lists; }

    // Handlers.
    void lstSuggestions_ItemClick(int list, qsizetype row);
    void txtSuggestions_Change();
    void SSTab1_Click(int tab);
    void lblOpenSite_Click();
    void cmdOk_Click();
    void cmdCancel_Click();

protected:
    void closeEvent(QCloseEvent *event) override;
    bool eventFilter(QObject *watched, QEvent *event) override;

private:
    void Offer(const ConfirmOffer &offer) override;

    void BuildWindow();
    void CloseWindow();
    QTableView *BuildList(int list);
    void SetSuggestionsText(const QString &text);
    QString Lookup(const QString &word, int list, qsizetype row);
    void ProcessPendingEvents();
    void ReportSaveFailures(qsizetype failures);
    void ResetSkins();
    int SelectedList() const;
    qsizetype SelectedItem() const;

    SuggestionsHost &m_host;
    UiServices &m_ui;
    WordStore m_store;
    WordLists m_lists;
    WordListModel *m_models[2] = {nullptr, nullptr};
    QElapsedTimer m_sinceEvents;
    bool m_lastSaveFailed = false;

    QWidget *Picture1 = nullptr;
    QWidget *fraWords = nullptr;        ///< panels on the background, hovered as the background
    QWidget *fraAlternatives = nullptr;
    QLabel *lblHeading = nullptr;
    QTabWidget *SSTab1 = nullptr;
    QTableView *lstSuggestions[2] = {nullptr, nullptr};
    QLabel *lblActiveWord = nullptr;
    QLabel *lblMessage = nullptr;
    QPlainTextEdit *txtSuggestions = nullptr;
    QPlainTextEdit *txtSample = nullptr;
    QLabel *lblTotal = nullptr;
    QCheckBox *chkDontPrompt = nullptr;
    ImageCommand *lblOpenSite = nullptr;
    ImageCommand *cmdOk = nullptr;
    ImageCommand *cmdCancel = nullptr;
    QWidget *pctStatus = nullptr;
    QLabel *lblWord = nullptr;
    QProgressBar *pBar = nullptr;
    QLabel *lblList = nullptr;
    QLabel *lblItem = nullptr;
};

} // namespace verbloom
