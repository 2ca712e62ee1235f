#include "frmSuggestions.h"

#include "engine/SpinGenerator.h"
#include "engine/SuggestionsHost.h"
#include "engine/frmSuggestionsModel.h"
#include "engine/frmConfirmOptions.h"
#include "common/ProgramFolder.h"
#include "shell/ImageCommand.h"
#include "shell/UiServices.h"

#include <QCheckBox>
#include <QCloseEvent>
#include <QCoreApplication>
#include <QFontMetrics>
#include <QFrame>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QItemSelectionModel>
#include <QLabel>
#include <QPlainTextEdit>
#include <QProgressBar>
#include <QTabWidget>
#include <QTableView>
#include <QVBoxLayout>
#include <QWindow>

#include <algorithm>
#include <limits>

namespace verbloom {

namespace {

// While the lists fill, pending events are let through at least this often.
constexpr qint64 EventIntervalMs = 12;

int ClampToInt(qsizetype value)
{
    return static_cast<int>(std::clamp<qsizetype>(value, 0, std::numeric_limits<int>::max()));
}

QLabel *Caption(const QString &text, QWidget *parent, const QString &name = QString())
{
    auto *label = new QLabel(text, parent);
    if (!name.isEmpty())
        label->setObjectName(name);
    return label;
}

// Widens a command so that its caption is not cut short; the height stays that of the skin.
void FitCaption(ImageCommand *command)
{
    QFont font = command->Label()->font();
    font.setWeight(QFont::DemiBold);
    const int needed = QFontMetrics(font).horizontalAdvance(command->Caption()) + 28;
    command->setFixedWidth(std::max(command->width(), needed));
}

// A white panel of the window; mouse moves over it count as moves over the background.
QFrame *Card(const QString &name, QWidget *parent, QObject *filter)
{
    auto *card = new QFrame(parent);
    card->setObjectName(name);
    card->setMouseTracking(true);
    card->installEventFilter(filter);
    return card;
}

} // namespace

frmSuggestions::frmSuggestions(SuggestionsHost &host, UiServices &ui, QWidget *parent)
    : QWidget(parent, Qt::Window)
    , m_host(host)
    , m_ui(ui)
    , m_store(ProgramFolder())
{
    setObjectName(QStringLiteral("frmSuggestions"));
    setWindowTitle(QStringLiteral("Confirm Suggestions"));
    BuildWindow();

    m_lists.RowsInserted = [this](int list, qsizetype, qsizetype) {
        if (list == 0 || list == 1)
            m_models[list]->RowsAppended();
    };
    m_lists.RowChanged = [this](int list, qsizetype row) {
        if (list == 0 || list == 1)
            m_models[list]->RowChanged(row);
    };
    m_lists.Reset = [this] {
        m_models[0]->ListsReset();
        m_models[1]->ListsReset();
    };
}

frmSuggestions::~frmSuggestions()
{
    m_lists.RowsInserted = nullptr;
    m_lists.RowChanged = nullptr;
    m_lists.Reset = nullptr;
}

void frmSuggestions::BuildWindow()
{
    auto *outer = new QVBoxLayout(this);
    outer->setContentsMargins(0, 0, 0, 0);
    Picture1 = new QWidget(this);
    Picture1->setObjectName(QStringLiteral("Picture1"));
    Picture1->setAttribute(Qt::WA_StyledBackground);
    Picture1->setMouseTracking(true);
    Picture1->installEventFilter(this);
    Picture1->setStyleSheet(QStringLiteral(
        "#Picture1 { background: #eef1f6; border: none; border-radius: 0; }"
        "#fraWords, #fraAlternatives { background: white; border: 1px solid #d6dce6; border-radius: 8px; }"
        "#lblHeading { font-size: 16pt; font-weight: 600; color: #1b2740; }"
        "#lblSelectWord, #lblMessage, #lblSampleCaption { color: #4a5870; }"
        "#lblActiveWord { font-size: 14pt; font-weight: 600; color: #24497f; }"
        "#lblTotal { color: #6b778c; }"
        "QTabWidget::pane { border: 1px solid #c5cedb; border-radius: 4px; top: -1px; }"
        "QTableView { border: none; background: white;"
        "    alternate-background-color: #f6f8fc; selection-background-color: #3f86e0; }"
        "#txtSample { background: #fafbfd; color: #1b2740; }"
        "#pctStatus { background: #e4ecf8; border: 1px solid #9fb3d1; border-radius: 8px; }"
        "#lblWord { font-weight: 600; color: #24497f; }"));
    outer->addWidget(Picture1);

    lblHeading = Caption(QStringLiteral("Suggest Some Alternate Words"), Picture1, QStringLiteral("lblHeading"));

    // Left: the two word lists.
    SSTab1 = new QTabWidget(Picture1);
    SSTab1->setObjectName(QStringLiteral("SSTab1"));
    SSTab1->setDocumentMode(false);
    SSTab1->addTab(BuildList(0), QStringLiteral("Title"));
    SSTab1->addTab(BuildList(1), QStringLiteral("Contents"));
    lblTotal = Caption(TotalCaption(0), Picture1, QStringLiteral("lblTotal"));

    fraWords = Card(QStringLiteral("fraWords"), Picture1, this);
    auto *left = new QVBoxLayout(fraWords);
    left->setContentsMargins(14, 12, 14, 12);
    left->setSpacing(8);
    left->addWidget(Caption(QStringLiteral("Select a word here"), Picture1, QStringLiteral("lblSelectWord")));
    left->addWidget(SSTab1, 1);
    left->addWidget(lblTotal);

    // Right: the selected word, its alternatives and the sample.
    lblMessage = Caption(QStringLiteral("Enter some alternatives for the word:"), Picture1, QStringLiteral("lblMessage"));
    lblMessage->setWordWrap(true);
    lblActiveWord = Caption(QString(), Picture1, QStringLiteral("lblActiveWord"));
    lblActiveWord->setTextFormat(Qt::PlainText);
    txtSuggestions = new QPlainTextEdit(Picture1);
    txtSuggestions->setObjectName(QStringLiteral("txtSuggestions"));
    txtSuggestions->setTabChangesFocus(true);
    txtSuggestions->setPlaceholderText(QStringLiteral("alternative, another alternative, ..."));
    txtSuggestions->setFixedHeight(txtSuggestions->fontMetrics().lineSpacing() * 4 + 14);
    chkDontPrompt = new QCheckBox(QStringLiteral("Manual"), Picture1);
    chkDontPrompt->setObjectName(QStringLiteral("chkDontPrompt"));
    lblOpenSite = new ImageCommand(QStringLiteral("lblOpenSite"), QStringLiteral("imglblOpenSite"),
                                   QStringLiteral("Get Suggenstion"), PicSkin, Picture1);
    FitCaption(lblOpenSite);
    auto *sampleCaption = Caption(
        QStringLiteral("This is a sample content. Click on the list on the left to generate again."), Picture1,
        QStringLiteral("lblSampleCaption"));
    sampleCaption->setWordWrap(true);
    txtSample = new QPlainTextEdit(Picture1);
    txtSample->setObjectName(QStringLiteral("txtSample"));
    txtSample->setReadOnly(true);

    auto *lookupRow = new QHBoxLayout;
    lookupRow->addWidget(chkDontPrompt);
    lookupRow->addStretch(1);
    lookupRow->addWidget(lblOpenSite);

    fraAlternatives = Card(QStringLiteral("fraAlternatives"), Picture1, this);
    auto *right = new QVBoxLayout(fraAlternatives);
    right->setContentsMargins(16, 12, 16, 14);
    right->setSpacing(8);
    right->addWidget(lblMessage);
    right->addWidget(lblActiveWord);
    right->addWidget(txtSuggestions);
    right->addLayout(lookupRow);
    right->addSpacing(10);
    right->addWidget(sampleCaption);
    right->addWidget(txtSample, 1);

    // The progress panel of the analysis.
    pctStatus = new QWidget(Picture1);
    pctStatus->setObjectName(QStringLiteral("pctStatus"));
    pctStatus->setAttribute(Qt::WA_StyledBackground);
    lblWord = Caption(QString(), pctStatus, QStringLiteral("lblWord"));
    lblWord->setTextFormat(Qt::PlainText);
    lblWord->setMinimumWidth(120);
    pBar = new QProgressBar(pctStatus);
    pBar->setObjectName(QStringLiteral("pBar"));
    pBar->setRange(0, 100);
    pBar->setValue(0);
    pBar->setTextVisible(false);
    auto *status = new QHBoxLayout(pctStatus);
    status->setContentsMargins(12, 8, 12, 8);
    status->addWidget(Caption(QStringLiteral("Please wait. Getting alternatives for:"), pctStatus));
    status->addWidget(lblWord);
    status->addWidget(pBar, 1);
    pctStatus->hide();

    cmdOk = new ImageCommand(QStringLiteral("cmdOk"), QStringLiteral("imgCmdOk"), QStringLiteral("Ok"),
                             PicSkin, Picture1);
    cmdCancel = new ImageCommand(QStringLiteral("cmdCancel"), QStringLiteral("imgcmdCancel"),
                                 QStringLiteral("Cancel"), PicSkin, Picture1);
    auto *commands = new QHBoxLayout;
    commands->setSpacing(10);
    commands->addStretch(1);
    commands->addWidget(cmdOk);
    commands->addWidget(cmdCancel);

    lblList = Caption(QStringLiteral("0"), Picture1, QStringLiteral("lblList"));
    lblList->hide();
    lblItem = Caption(QStringLiteral("0"), Picture1, QStringLiteral("lblItem"));
    lblItem->hide();

    auto *grid = new QGridLayout(Picture1);
    grid->setContentsMargins(18, 14, 18, 16);
    grid->setHorizontalSpacing(14);
    grid->setVerticalSpacing(12);
    grid->addWidget(lblHeading, 0, 0, 1, 2);
    grid->addWidget(fraWords, 1, 0);
    grid->addWidget(fraAlternatives, 1, 1);
    grid->addWidget(pctStatus, 2, 0, 1, 2);
    grid->addLayout(commands, 3, 0, 1, 2);
    grid->setColumnStretch(0, 5);
    grid->setColumnStretch(1, 6);
    grid->setRowStretch(1, 1);

    connect(SSTab1, &QTabWidget::currentChanged, this, &frmSuggestions::SSTab1_Click);
    connect(txtSuggestions, &QPlainTextEdit::textChanged, this, &frmSuggestions::txtSuggestions_Change);
    connect(lblOpenSite, &ImageCommand::clicked, this, &frmSuggestions::lblOpenSite_Click);
    connect(cmdOk, &ImageCommand::clicked, this, &frmSuggestions::cmdOk_Click);
    connect(cmdCancel, &ImageCommand::clicked, this, &frmSuggestions::cmdCancel_Click);
    for (ImageCommand *command : {lblOpenSite, cmdOk, cmdCancel})
        command->SetHoverSkin(PicHoverSkin);

    setMinimumSize(760, 500);
    resize(960, 640);
}

QTableView *frmSuggestions::BuildList(int list)
{
    auto *view = new QTableView;
    view->setObjectName(QStringLiteral("lstSuggestions") + QString::number(list));
    m_models[list] = new WordListModel(m_lists, list, view);
    view->setModel(m_models[list]);
    view->setSelectionBehavior(QAbstractItemView::SelectRows);
    view->setSelectionMode(QAbstractItemView::SingleSelection);
    view->setEditTriggers(QAbstractItemView::NoEditTriggers);
    view->setShowGrid(false);
    view->setAlternatingRowColors(true);
    view->setWordWrap(false);
    view->setCornerButtonEnabled(false);
    view->verticalHeader()->hide();
    view->verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
    view->verticalHeader()->setDefaultSectionSize(view->fontMetrics().height() + 6);
    QHeaderView *header = view->horizontalHeader();
    header->setHighlightSections(false);
    header->setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
    header->resizeSection(WordListModel::ColumnWord, 3000 / TwipsPerPixel);
    header->resizeSection(WordListModel::ColumnSimilar, 1000 / TwipsPerPixel);
    header->setStretchLastSection(true);
    view->setColumnHidden(WordListModel::ColumnSuggestions, true);
    view->installEventFilter(this);

    connect(view, &QAbstractItemView::clicked, this, [this, list](const QModelIndex &index) {
        lstSuggestions_ItemClick(list, index.row() + 1);
    });
    // Moving through the rows with the keyboard selects them as a click does.
    connect(view->selectionModel(), &QItemSelectionModel::currentRowChanged, this,
            [this, list, view](const QModelIndex &current) {
                if (current.isValid() && view->property("keyboardNavigation").toBool())
                    lstSuggestions_ItemClick(list, current.row() + 1);
            });
    lstSuggestions[list] = view;
    return view;
}

// ---- SuggestionsView

void frmSuggestions::ShowModeless()
{
    if (isVisible())
        return;
    show();
    activateWindow();
}

void frmSuggestions::ClearLists()
{
    // A selection of the old rows would name a different word of the new ones.
    lblList->setText(QString::number(SSTab1->currentIndex()));
    lblItem->setText(QStringLiteral("0"));
    m_lists.Clear();
    SetSuggestionsText(QString());
    txtSuggestions->setEnabled(true);
    lblMessage->setText(QStringLiteral("Enter some alternatives for the word:"));
    lblActiveWord->clear();
    lblActiveWord->show();
    txtSample->clear();
    lblTotal->setText(TotalCaption(0));
    m_sinceEvents.invalidate();
}

void frmSuggestions::SetStatusVisible(bool visible)
{
    if (!visible) {
        m_models[0]->Flush();
        m_models[1]->Flush();
    }
    pctStatus->setVisible(visible);
}

void frmSuggestions::SetProgressMaximum(qsizetype maximum)
{
    pBar->setMaximum(ClampToInt(maximum));
}

void frmSuggestions::SetProgressValue(qsizetype value)
{
    pBar->setValue(std::min(ClampToInt(value), pBar->maximum()));
}

void frmSuggestions::SetWordCaption(const QString &caption)
{
    lblWord->setText(caption);
}

void frmSuggestions::SelectContentsTab()
{
    SSTab1->setCurrentIndex(1);
}

void frmSuggestions::AddItems(const QString &word, int list)
{
    AddItemsHooks hooks;
    hooks.SetCaption = [this](const QString &caption) { setWindowTitle(caption); };
    hooks.ProcessEvents = [this] { ProcessPendingEvents(); };
    hooks.Manual = [this] { return chkDontPrompt->isChecked(); };
    hooks.Lookup = [this](const QString &w, int l, qsizetype row) { return Lookup(w, l, row); };
    hooks.SetTotal = [this](const QString &text) { lblTotal->setText(text); };
    verbloom::AddItems(m_lists, word, list, m_host.CurrentWordTestSettings(), m_store, hooks);
}

void frmSuggestions::Unload()
{
    hide();
}

// ---- Rows, samples and word files

qsizetype frmSuggestions::SaveData()
{
    const qsizetype failures = verbloom::SaveData(m_lists, m_host.CurrentWordTestSettings(), m_store);
    ReportSaveFailures(failures);
    return failures;
}

void frmSuggestions::ReportSaveFailures(qsizetype failures)
{
    // Said once when saving starts to fail, not again on every click until it works again.
    if (failures > 0 && !m_lastSaveFailed) {
        m_ui.Say(this,
                 QStringLiteral("The alternatives of ") + QString::number(failures)
                     + QStringLiteral(" word(s) could not be saved in the folder \"")
                     + m_store.DataFolder()
                     + QStringLiteral("\". They stay in this window until they can be saved."),
                 UiServices::Icon::Exclamation);
    }
    m_lastSaveFailed = failures > 0;
}

void frmSuggestions::PopulateContent()
{
    SaveData();
    WordFileAlternatives source(m_store);
    Spinner spinner(CurrentArticle(), m_host.CurrentSpinSettings(), source, ProcessRandom());
    QString sample = SSTab1->currentIndex() == 0 ? spinner.SpinTitle() : spinner.SpinContents();
    sample.replace(QStringLiteral("\r\n"), QStringLiteral("\n"));
    txtSample->setPlainText(sample);
}

void frmSuggestions::TakeConfirmedChoice(const QString &list, const QString &item, const QString &alternatives)
{
    lblList->setText(list);
    lblItem->setText(item);
    // The box may already show this text for another row; the choice still belongs to this one.
    // An empty choice over an empty box leaves the row as it is.
    if (txtSuggestions->toPlainText() == alternatives && !alternatives.isEmpty())
        txtSuggestions_Change();
    else
        SetSuggestionsText(alternatives);
}

void frmSuggestions::CheckManual()
{
    chkDontPrompt->setChecked(true);
}

int frmSuggestions::SelectedList() const
{
    bool ok = false;
    const int list = lblList->text().toInt(&ok);
    return ok ? list : -1;
}

qsizetype frmSuggestions::SelectedItem() const
{
    bool ok = false;
    const qsizetype item = lblItem->text().toLongLong(&ok);
    return ok ? item : -1;
}

void frmSuggestions::SetSuggestionsText(const QString &text)
{
    // A text box reports a change only when its text really changes.
    if (txtSuggestions->toPlainText() != text)
        txtSuggestions->setPlainText(text);
}

// ---- Handlers

void frmSuggestions::lstSuggestions_ItemClick(int list, qsizetype row)
{
    if (list < 0 || list > 1 || row < 1 || row > m_lists.Count(list))
        return;
    lblItem->setText(QString::number(row));
    lblList->setText(QString::number(list));
    const WordRow selected = m_lists.Row(list, row - 1);
    if (IsCustomizableWord(selected.Text, m_host.CurrentWordTestSettings())) {
        txtSuggestions->setEnabled(true);
        lblMessage->setText(QStringLiteral("Enter some alternatives for the word:"));
        lblActiveWord->show();
    } else {
        txtSuggestions->setEnabled(false);
        lblMessage->setText(QStringLiteral("No alternatives needed for this word. Please select another word"));
        lblActiveWord->hide();
    }
    SetSuggestionsText(selected.Alternatives);
    lblActiveWord->setText(selected.Text);
    PopulateContent();
}

void frmSuggestions::txtSuggestions_Change()
{
    const qsizetype item = SelectedItem();
    const int list = SelectedList();
    if (item <= 0 || list < 0 || list > 1 || item > m_lists.Count(list))
        return;
    m_lists.SetAlternatives(list, item - 1, txtSuggestions->toPlainText());
}

void frmSuggestions::SSTab1_Click(int tab)
{
    lblList->setText(QString::number(tab));
    lblItem->setText(QStringLiteral("-1"));
}

void frmSuggestions::lblOpenSite_Click()
{
    setEnabled(false);
    chkDontPrompt->setChecked(false);
    const qsizetype item = SelectedItem();
    const int list = SelectedList();
    bool nothingFound = false;
    if (item > 0 && (list == 0 || list == 1) && item <= m_lists.Count(list)) {
        const QString word = m_lists.Row(list, item - 1).Text;
        nothingFound = Lookup(word, list, item).isEmpty();
    }
    // Enabled before the message, which would otherwise open disabled over this window.
    setEnabled(true);
    if (nothingFound)
        m_ui.Say(this, QStringLiteral("Could not think of an alternative. You will have to type one yourself."));
}

void frmSuggestions::cmdOk_Click()
{
    SaveData();
    CloseWindow();
}

void frmSuggestions::cmdCancel_Click()
{
    StopProcessing = true;
    CloseWindow();
    m_host.ShowWaitWindow();
    m_host.HideMainWindow();
    if (m_host.AnalysisRunning())
        return; // the analysis takes the way back at its next contents token
    // No analysis is running to take the way back, so it is taken here.
    TakeWayBack(*this, m_host);
}

void frmSuggestions::CloseWindow()
{
    hide();
    m_host.ShowMainWindow();
    m_host.SetButton(true);
    m_host.ShowVerifyPage();
    m_host.cmdVerifyTryAgain_Click();
}

void frmSuggestions::closeEvent(QCloseEvent *event)
{
    if (QCoreApplication::closingDown()) {
        event->accept();
        return;
    }
    // The window stays loaded with its rows; while a lookup runs it cannot be closed.
    event->ignore();
    if (isEnabled())
        CloseWindow();
}

// ---- Lookup

QString frmSuggestions::Lookup(const QString &word, int list, qsizetype row)
{
    LookupContext context;
    context.Host = m_host.ThesaurusHost();
    if (context.Host.isEmpty())
        return {};
    context.Manual = chkDontPrompt->isChecked();
    context.Article = &CurrentArticle();
    context.Page = &m_host.LookupPage();
    context.Confirm = this;
    return FetchAlternatives(word, QString(), list, row, context);
}

void frmSuggestions::Offer(const ConfirmOffer &offer)
{
    // No parent: a window disabled for "Get Suggenstion" would disable its child windows too.
    frmConfirmOptions window(*this);
    lblActiveWord->setText(offer.Word);
    window.SetQuestion(offer.Question);
    window.SetTarget(offer.List, offer.Row);
    window.setWindowTitle(offer.Caption);
    window.SetSentence(offer.Sentence);
    for (const MeaningEntry &meaning : offer.Meanings)
        window.AddMeaning(meaning.EntryWord, meaning.Synonyms);
    if (isVisible()) {
        // Kept above this window by the window manager without being its child.
        window.winId();
        window.windowHandle()->setTransientParent(windowHandle());
        window.move(frameGeometry().center() - window.rect().center());
    }
    window.exec();
}

void frmSuggestions::ProcessPendingEvents()
{
    if (m_sinceEvents.isValid() && m_sinceEvents.elapsed() < EventIntervalMs)
        return;
    QCoreApplication::processEvents();
    m_sinceEvents.start();
}

// ---- Hover skins

void frmSuggestions::ResetSkins()
{
    lblOpenSite->SetSkin(PicSkin);
    cmdOk->SetSkin(PicSkin);
    cmdCancel->SetSkin(PicSkin);
}

bool frmSuggestions::eventFilter(QObject *watched, QEvent *event)
{
    if ((watched == Picture1 || watched == fraWords || watched == fraAlternatives)
        && event->type() == QEvent::MouseMove) {
        ResetSkins();
    } else if (watched == lstSuggestions[0] || watched == lstSuggestions[1]) {
        if (event->type() == QEvent::KeyPress)
            watched->setProperty("keyboardNavigation", true);
        else if (event->type() == QEvent::KeyRelease || event->type() == QEvent::FocusOut)
            watched->setProperty("keyboardNavigation", false);
    }
    return QWidget::eventFilter(watched, event);
}

} // namespace verbloom
