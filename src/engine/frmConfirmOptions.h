#pragma once

#include <QDialog>

class QCheckBox;
class QLabel;
class QLineEdit;
class QTreeWidget;

namespace verbloom {

class ImageCommand;
class frmSuggestions;

/// The confirm-meaning window: the meanings a lookup found for one word, with check boxes, and a
/// custom meaning. "Save Selected" hands the choice to the suggestions window's word row named by
/// the hidden labels; "Ignore Word" and the close box write nothing. Made anew for every offer
/// and shown modally.
class frmConfirmOptions final : public QDialog
{
    Q_OBJECT

public:
    explicit frmConfirmOptions(frmSuggestions &suggestions, QWidget *parent = nullptr);

    /// lblSuggestLabel: the question of the lookup.
    void SetQuestion(const QString &question);
    /// lblSuggestSentence: the tokens around the word.
    void SetSentence(const QString &sentence);
    /// The hidden lblList and lblItem: the word row to fill (list 0 or 1, row from 1).
    void SetTarget(int list, qsizetype row);
    /// One row of lstSuggestionsFromWeb: the entry word and its synonyms, unticked.
    void AddMeaning(const QString &entryWord, const QString &synonyms);

    /// What "Save Selected" stores: txtCustom, then the entry word and synonyms of every ticked
    /// row from the top, joined with ", ", each part trimmed of blanks.
    QString SelectedAlternatives() const;

    // Handlers.
    void cmdSuggestionOk_Click();
    void cmdIgnore_Click();
    void chkSuggestionDoNotPrompt_Click();

protected:
    bool eventFilter(QObject *watched, QEvent *event) override;

private:
    void ResetSkins();

    frmSuggestions &m_suggestions;

    QWidget *pctOptions = nullptr;
    QLabel *lblSuggestLabel = nullptr;
    QLabel *lblSuggestSentence = nullptr;
    QTreeWidget *lstSuggestionsFromWeb = nullptr;
    QLineEdit *txtCustom = nullptr;
    QCheckBox *chkSuggestionDoNotPrompt = nullptr;
    ImageCommand *cmdSuggestionOk = nullptr;
    ImageCommand *cmdIgnore = nullptr;
    QLabel *lblList = nullptr;
    QLabel *lblItem = nullptr;
};

} // namespace verbloom
