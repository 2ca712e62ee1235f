#include "frmConfirmOptions.h"

#include "engine/AlternativesList.h"
#include "engine/frmSuggestions.h"
#include "shell/ImageCommand.h"

#include <algorithm>

#include <QCheckBox>
#include <QEvent>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QTreeWidget>
#include <QVBoxLayout>

namespace verbloom {

frmConfirmOptions::frmConfirmOptions(frmSuggestions &suggestions, QWidget *parent)
    : QDialog(parent)
    , m_suggestions(suggestions)
{
    setObjectName(QStringLiteral("frmConfirmOptions"));
    setWindowTitle(QStringLiteral("Select appropriate meaning of word :"));
    setModal(true);
    setSizeGripEnabled(true);

    pctOptions = new QWidget(this);
    pctOptions->setObjectName(QStringLiteral("pctOptions"));
    pctOptions->setMouseTracking(true);
    pctOptions->installEventFilter(this);
    pctOptions->setAttribute(Qt::WA_StyledBackground);
    pctOptions->setStyleSheet(QStringLiteral(
        "#pctOptions { background: #eef1f6; }"
        "#lblSuggestLabel { font-size: 12pt; font-weight: 600; color: #1b2740; }"
        "#lstSuggestionsFromWeb::item { padding: 3px 2px; }"
        "#lblSuggestSentence { background: white; border: 1px solid #d6dce6; border-radius: 6px;"
        " padding: 8px 10px; color: #33415c; font-style: italic; }"));
    auto *outer = new QVBoxLayout(this);
    outer->setContentsMargins(0, 0, 0, 0);
    outer->addWidget(pctOptions);

    lblSuggestLabel = new QLabel(QStringLiteral("Which word is closest in meaning to xxxxx in the sentence:"),
                                 pctOptions);
    lblSuggestLabel->setObjectName(QStringLiteral("lblSuggestLabel"));
    lblSuggestLabel->setWordWrap(true);

    lblSuggestSentence = new QLabel(pctOptions);
    lblSuggestSentence->setObjectName(QStringLiteral("lblSuggestSentence"));
    lblSuggestSentence->setWordWrap(true);
    lblSuggestSentence->setTextFormat(Qt::PlainText);
    lblSuggestSentence->setTextInteractionFlags(Qt::TextSelectableByMouse);

    lstSuggestionsFromWeb = new QTreeWidget(pctOptions);
    lstSuggestionsFromWeb->setObjectName(QStringLiteral("lstSuggestionsFromWeb"));
    lstSuggestionsFromWeb->setColumnCount(2);
    lstSuggestionsFromWeb->setHeaderLabels({QStringLiteral("Word"), QStringLiteral("Suggestions")});
    lstSuggestionsFromWeb->setRootIsDecorated(false);
    lstSuggestionsFromWeb->setAlternatingRowColors(true);
    lstSuggestionsFromWeb->setWordWrap(true);
    lstSuggestionsFromWeb->setTextElideMode(Qt::ElideNone);
    lstSuggestionsFromWeb->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    // "Word" keeps its width; "Suggestions" takes the rest and wraps, so every synonym is seen.
    lstSuggestionsFromWeb->header()->setStretchLastSection(true);
    lstSuggestionsFromWeb->header()->resizeSection(0, 2500 / TwipsPerPixel);

    auto *customCaption = new QLabel(QStringLiteral("Add a custom meaning"), pctOptions);
    txtCustom = new QLineEdit(pctOptions);
    txtCustom->setObjectName(QStringLiteral("txtCustom"));
    customCaption->setBuddy(txtCustom);

    chkSuggestionDoNotPrompt = new QCheckBox(QStringLiteral("Do not prompt again."), pctOptions);
    chkSuggestionDoNotPrompt->setObjectName(QStringLiteral("chkSuggestionDoNotPrompt"));

    cmdSuggestionOk = new ImageCommand(QStringLiteral("lblSuggestionOk"), QStringLiteral("cmdSuggestionOk"),
                                       QStringLiteral("Save Selected"), PicSkin, pctOptions);
    cmdIgnore = new ImageCommand(QStringLiteral("lblIgnore"), QStringLiteral("cmdIgnore"),
                                 QStringLiteral("Ignore Word"), PicSkin, pctOptions);

    lblList = new QLabel(QStringLiteral("0"), pctOptions);
    lblList->setObjectName(QStringLiteral("lblList"));
    lblList->hide();
    lblItem = new QLabel(QStringLiteral("0"), pctOptions);
    lblItem->setObjectName(QStringLiteral("lblItem"));
    lblItem->hide();

    auto *layout = new QVBoxLayout(pctOptions);
    layout->setContentsMargins(18, 16, 18, 16);
    layout->setSpacing(10);
    layout->addWidget(lblSuggestLabel);
    layout->addWidget(lblSuggestSentence);
    layout->addWidget(lstSuggestionsFromWeb, 1);
    layout->addWidget(customCaption);
    layout->addWidget(txtCustom);
    auto *bottom = new QHBoxLayout;
    bottom->addWidget(chkSuggestionDoNotPrompt);
    bottom->addStretch(1);
    bottom->addWidget(cmdSuggestionOk);
    bottom->addWidget(cmdIgnore);
    layout->addLayout(bottom);

    connect(cmdSuggestionOk, &ImageCommand::clicked, this, &frmConfirmOptions::cmdSuggestionOk_Click);
    connect(cmdIgnore, &ImageCommand::clicked, this, &frmConfirmOptions::cmdIgnore_Click);
    connect(chkSuggestionDoNotPrompt, &QCheckBox::clicked, this,
            &frmConfirmOptions::chkSuggestionDoNotPrompt_Click);
    for (ImageCommand *command : {cmdSuggestionOk, cmdIgnore})
        command->SetHoverSkin(PicHoverSkin);

    // Meanings are ticked with the mouse; the keyboard starts in the custom meaning.
    txtCustom->setFocus();
    resize(720, 460);
    setMinimumSize(480, 340);
}

void frmConfirmOptions::SetQuestion(const QString &question)
{
    lblSuggestLabel->setText(question);
}

void frmConfirmOptions::SetSentence(const QString &sentence)
{
    lblSuggestSentence->setText(sentence);
}

void frmConfirmOptions::SetTarget(int list, qsizetype row)
{
    lblList->setText(QString::number(list));
    lblItem->setText(QString::number(row));
}

void frmConfirmOptions::AddMeaning(const QString &entryWord, const QString &synonyms)
{
    auto *item = new QTreeWidgetItem(lstSuggestionsFromWeb, {entryWord, synonyms});
    item->setFlags(item->flags() | Qt::ItemIsUserCheckable);
    item->setCheckState(0, Qt::Unchecked);
    item->setToolTip(1, synonyms);
}

QString frmConfirmOptions::SelectedAlternatives() const
{
    QString result = TrimSpaces(txtCustom->text());
    for (int i = 0; i < lstSuggestionsFromWeb->topLevelItemCount(); ++i) {
        const QTreeWidgetItem *item = lstSuggestionsFromWeb->topLevelItem(i);
        if (item->checkState(0) != Qt::Checked)
            continue;
        const QString entryWord = item->text(0);
        const QString synonyms = TrimSpaces(item->text(1));
        // The entry word goes in front of its synonyms, unless it already is one of them.
        const QStringList pieces = SplitAlternatives(synonyms);
        const bool listed = std::any_of(pieces.cbegin(), pieces.cend(), [&entryWord](const QString &piece) {
            return TrimSpaces(piece).compare(entryWord, Qt::CaseInsensitive) == 0;
        });
        const QString meaning = listed ? synonyms : entryWord + QStringLiteral(", ") + synonyms;
        result = result.isEmpty() ? meaning : result + QStringLiteral(", ") + meaning;
    }
    return result;
}

void frmConfirmOptions::cmdSuggestionOk_Click()
{
    m_suggestions.TakeConfirmedChoice(lblList->text(), lblItem->text(), SelectedAlternatives());
    accept();
}

void frmConfirmOptions::cmdIgnore_Click()
{
    reject();
}

void frmConfirmOptions::chkSuggestionDoNotPrompt_Click()
{
    if (chkSuggestionDoNotPrompt->isChecked())
        m_suggestions.CheckManual();
}

bool frmConfirmOptions::eventFilter(QObject *watched, QEvent *event)
{
    if (watched == pctOptions && event->type() == QEvent::MouseMove)
        ResetSkins();
    return QDialog::eventFilter(watched, event);
}

void frmConfirmOptions::ResetSkins()
{
    cmdSuggestionOk->SetSkin(PicSkin);
    cmdIgnore->SetSkin(PicSkin);
}

} // namespace verbloom
