#include "frmMain.h"

#include "BrowserPageSource.h"
#include "frmOpenURL.h"
#include "frmWait.h"
#include "ImageCommand.h"
#include "UiServices.h"
#include "WebEngineBrowser.h"

#include "common/IniFile.h"
#include "common/LineEnds.h"
#include "common/ProgramFolder.h"
#include "common/TextFile.h"
#include "engine/RandomSource.h"
#include "engine/SpinGenerator.h"
#include "engine/WordStore.h"
#include "engine/frmSuggestions.h"
#include "export/ExportResult.h"
#include "shell/ArticleChecks.h"
#include "shell/ArticleModel.h"

#include <QCloseEvent>
#include <QComboBox>
#include <QCoreApplication>
#include <QDir>
#include <QFrame>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QStackedLayout>
#include <QTextCursor>
#include <QTimer>
#include <QTreeWidget>
#include <QVBoxLayout>

namespace verbloom {

namespace {

constexpr int BannerHeight = 1695 / TwipsPerPixel;
constexpr int ButtonBarWidth = 2355 / TwipsPerPixel;
constexpr int IgnoredWordsColumnWidth = 3000 / TwipsPerPixel;
// Room between the verify page and the row of the wizard button below it.
constexpr int VerifyPageGap = 8;

const QString TextFileFilter = QStringLiteral("*.txt Text Files (*.txt);;*.* All Files (*)");
const QString CrLf = QStringLiteral("\r\n");

QLabel *MakeLabel(const QString &text, QWidget *parent, const QString &name = QString())
{
    auto *label = new QLabel(text, parent);
    if (!name.isEmpty())
        label->setObjectName(name);
    return label;
}

QString BannerHtml()
{
    return u"<!DOCTYPE html><html><head><title>Verbloom</title><style>"
           "html,body{margin:0;height:100%;overflow:hidden;font-family:'DejaVu Sans',Arial,sans-serif}"
           "body{background:linear-gradient(100deg,#17233a 0%,#24497f 55%,#3f86e0 100%);color:#fff;"
           "display:flex;align-items:center}"
           ".b{padding-left:30px}.t{font-size:30px;font-weight:700;letter-spacing:1px}"
           ".t span{color:#ffb347}.s{font-size:14px;opacity:.85;margin-top:6px}"
           "</style></head><body><div class='b'><div class='t'>Verb<span>loom</span></div>"
           "<div class='s'>Write one article, publish many unique versions.</div></div></body></html>"_qs;
}

} // namespace

const QString frmMain::NextCaption = QStringLiteral("        Next");
const QString frmMain::GoBackCaption = QStringLiteral("        Go Back");

frmMain::frmMain(UiServices &ui, const QString &thesaurusHost, QWidget *parent)
    : QWidget(parent)
    , m_ui(ui)
    , m_thesaurusHost(thesaurusHost)
{
    setObjectName(u"frmMain"_qs);
    setWindowTitle(u"Verbloom"_qs);
    BuildWindow();
    m_lookupPage = std::make_unique<BrowserPageSource>(*m_webData);
    m_suggestions = new frmSuggestions(*this, m_ui, this);
    Form_Load();
}

frmMain::~frmMain()
{
    delete m_wait;
}

// ---------------------------------------------------------------------------------------------
// Building the window

ImageCommand *frmMain::AddCommand(const QString &labelName, const QString &imageName,
                                  const QString &caption, QWidget *parent, void (frmMain::*handler)(),
                                  bool labelHighlights)
{
    auto *command = new ImageCommand(labelName, imageName, caption, BlueSkin, parent);
    connect(command, &ImageCommand::clicked, this, handler);
    if (labelHighlights) {
        command->SetHoverSkin(BlueHoverSkin);
    } else {
        // Only the image highlights; a move over the caption just clears its frame.
        connect(command, &ImageCommand::mouseMovedOverImage, this,
                [command] { command->SetSkin(BlueHoverSkin); });
        connect(command, &ImageCommand::mouseMovedOverLabel, this,
                [command] { command->Label()->setFrameShape(QFrame::NoFrame); });
    }
    return command;
}

void frmMain::BuildWindow()
{
    setMouseTracking(true);
    installEventFilter(this);

    Picture3 = new QWidget(this);
    Picture3->setObjectName(u"Picture3"_qs);
    Picture3->setFixedHeight(BannerHeight);
    m_banner = new WebEngineBrowser(Picture3);
    m_banner->setObjectName(u"WebBrowser1"_qs);
    m_banner->View()->setObjectName(u"WebBrowser1View"_qs);
    auto *bannerLayout = new QVBoxLayout(Picture3);
    bannerLayout->setContentsMargins(0, 0, 0, 0);
    bannerLayout->addWidget(m_banner->View());

    pctMain[1] = new QWidget(this);
    pctMain[1]->setObjectName(u"pctMain(1)"_qs);
    auto *mainPageLayout = new QHBoxLayout(pctMain[1]);
    mainPageLayout->setContentsMargins(0, 0, 0, 0);
    mainPageLayout->setSpacing(0);
    mainPageLayout->addWidget(BuildButtonBar());

    fraF = new QFrame(pctMain[1]);
    fraF->setObjectName(u"fraF"_qs);
    auto *frameLayout = new QVBoxLayout(fraF);
    frameLayout->setContentsMargins(24, 16, 24, 16);
    frameLayout->setSpacing(10);
    auto *headings = new QGridLayout;
    lblArticle = MakeLabel(u"Enter an article Here"_qs, fraF, u"lblArticle"_qs);
    lblConfiguration = MakeLabel(u"Configuration"_qs, fraF, u"lblConfiguration"_qs);
    headings->addWidget(lblArticle, 0, 0);
    headings->addWidget(lblConfiguration, 0, 0);
    frameLayout->addLayout(headings);

    pctMain[0] = new QWidget(fraF);
    pctMain[0]->setObjectName(u"pctMain(0)"_qs);
    auto *wizardLayout = new QVBoxLayout(pctMain[0]);
    wizardLayout->setContentsMargins(0, 0, 0, 0);
    wizardLayout->setSpacing(12);
    auto *panelHost = new QWidget(pctMain[0]);
    m_panels = new QStackedLayout(panelHost);
    m_panels->addWidget(BuildArticlePanel());
    m_panels->addWidget(BuildConfigurationPanel());
    wizardLayout->addWidget(panelHost, 1);

    // The maintenance command lies behind the two panels: never seen, still there.
    Command1 = new QPushButton(u"Command1"_qs, pctMain[0]);
    Command1->setObjectName(u"Command1"_qs);
    Command1->hide();
    connect(Command1, &QPushButton::clicked, this, &frmMain::Command1_Click);

    auto *nextRow = new QHBoxLayout;
    nextRow->addStretch(1);
    cmdNext = AddCommand(u"cmdNext"_qs, u"imgNext"_qs, NextCaption, pctMain[0], &frmMain::cmdNext_Click, false);
    nextRow->addWidget(cmdNext);
    wizardLayout->addLayout(nextRow);
    frameLayout->addWidget(pctMain[0], 1);
    mainPageLayout->addWidget(fraF, 1);

    // The hidden lookup browser and the hidden article list lie outside the visible area.
    m_webData = new WebEngineBrowser(this);
    m_webData->setObjectName(u"webData"_qs);
    m_webData->View()->setObjectName(u"webDataView"_qs);
    m_webData->View()->hide();
    lstArticles = new QTreeWidget(this);
    lstArticles->setObjectName(u"lstArticles"_qs);
    lstArticles->setHeaderLabels({u"keyword"_qs, u"title"_qs, u"description"_qs});
    lstArticles->setRootIsDecorated(false);
    lstArticles->hide();

    auto *layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setSpacing(0);
    layout->addWidget(Picture3);
    layout->addWidget(pctMain[1], 1);

    // The verify page is a child of the window, laid over the frame above the wizard button.
    pctMain[2] = BuildVerifyPage();
    pctMain[2]->hide();
    fraF->installEventFilter(this);
    cmdNext->installEventFilter(this);

    for (QWidget *background : {static_cast<QWidget *>(fraButtons), static_cast<QWidget *>(fraF),
                                Picture1, Picture2, pctMain[0], pctMain[1], pctMain[2]}) {
        background->setMouseTracking(true);
        background->installEventFilter(this);
    }
    resize(960, 700);
    setMinimumSize(820, 600);
}

QWidget *frmMain::BuildButtonBar()
{
    fraButtons = new QFrame(pctMain[1]);
    fraButtons->setObjectName(u"fraButtons"_qs);
    fraButtons->setFixedWidth(ButtonBarWidth);
    auto *layout = new QVBoxLayout(fraButtons);
    layout->setContentsMargins(0, 20, 0, 16);
    layout->setSpacing(10);

    cmdArticle = AddCommand(u"cmdArticle"_qs, u"imgCmdArticle"_qs, u"Enter Article "_qs, fraButtons,
                            &frmMain::cmdArticle_Click);
    cmdConfig = AddCommand(u"cmdConfig"_qs, u"imgCmdConfig"_qs, u"Configuration"_qs, fraButtons,
                           &frmMain::cmdConfig_Click);
    cmdVerifyTryAgain = AddCommand(u"cmdVerifyTryAgain"_qs, u"imgReGenerate"_qs, u"        ReGenerate"_qs,
                                   fraButtons, &frmMain::cmdVerifyTryAgain_Click);
    lblSaveAsxml = AddCommand(u"lblSaveAsxml"_qs, u"imgSaveAsXML"_qs, u"       SaveAs XML"_qs, fraButtons,
                              &frmMain::lblSaveAsxml_Click);
    lblSaveAsSQLfile = AddCommand(u"lblSaveAsSQLfile"_qs, u"imgSaveAsSql"_qs, u"        SaveAs SQL"_qs,
                                  fraButtons, &frmMain::lblSaveAsSQLfile_Click);
    cmdHelp = AddCommand(u"cmdHelp"_qs, u"imgHelp"_qs, u"          Help"_qs, fraButtons,
                         &frmMain::cmdHelp_Click, false);
    cmdGenerateSite = AddCommand(u"cmdGenerateSite"_qs, u"imgGenerateSite"_qs, u"        Gen. Site"_qs,
                                 fraButtons, &frmMain::cmdGenerateSite_Click);
    cmdSave = AddCommand(u"cmdSave"_qs, u"imgSaveContents"_qs, u"      Save Cont."_qs, fraButtons,
                         &frmMain::cmdSave_Click);

    // A click on the XML image shows its highlighted skin.
    connect(lblSaveAsxml, &ImageCommand::clicked, this, [this] { lblSaveAsxml->SetSkin(BlueHoverSkin); });

    for (ImageCommand *command : {cmdArticle, cmdConfig, cmdVerifyTryAgain, lblSaveAsxml, lblSaveAsSQLfile,
                                  cmdHelp, cmdGenerateSite, cmdSave})
        layout->addWidget(command, 0, Qt::AlignHCenter);
    layout->addStretch(1);
    return fraButtons;
}

QWidget *frmMain::BuildArticlePanel()
{
    Picture1 = new QWidget;
    Picture1->setObjectName(u"Picture1"_qs);
    Picture1->setAttribute(Qt::WA_StyledBackground);
    txtTitle = new QLineEdit(Picture1);
    txtTitle->setObjectName(u"txtTitle"_qs);
    txtTitle->setPlaceholderText(u"The title of your article"_qs);
    txtArticle = new QPlainTextEdit(Picture1);
    txtArticle->setObjectName(u"txtArticle"_qs);
    txtArticle->setVerticalScrollBarPolicy(Qt::ScrollBarAlwaysOn);
    txtArticle->setPlaceholderText(u"Type or paste the article here, or load it from a file or a web page."_qs);

    cmdBrowseURL = AddCommand(u"cmdBrowseURL"_qs, u"imgFromWebsite"_qs, u"     Website "_qs, Picture1,
                              &frmMain::cmdBrowseURL_Click);
    cmdBrowseTextFile = AddCommand(u"cmdBrowseTextFile"_qs, u"imgBrowseFile"_qs, u"     Browse File"_qs,
                                   Picture1, &frmMain::cmdBrowseTextFile_Click);
    cmdBrowseURL->SetToolTip(u"Load contents from a website. You will have to enter the URL here."_qs);
    cmdBrowseTextFile->SetToolTip(u"Load contents from a text file from your PC"_qs);

    auto *layout = new QGridLayout(Picture1);
    layout->setContentsMargins(18, 16, 18, 16);
    layout->setHorizontalSpacing(12);
    layout->setVerticalSpacing(10);
    layout->addWidget(MakeLabel(u"Title:"_qs, Picture1, u"lblTitle"_qs), 0, 0);
    layout->addWidget(txtTitle, 0, 1);
    layout->addWidget(MakeLabel(u"Contents:"_qs, Picture1, u"lblContents"_qs), 1, 0, Qt::AlignTop);
    layout->addWidget(txtArticle, 1, 1);
    auto *commands = new QHBoxLayout;
    commands->setSpacing(10);
    commands->addWidget(cmdBrowseURL);
    commands->addWidget(cmdBrowseTextFile);
    commands->addStretch(1);
    layout->addLayout(commands, 2, 1);
    layout->setRowStretch(1, 1);
    layout->setColumnStretch(1, 1);
    return Picture1;
}

QWidget *frmMain::BuildConfigurationPanel()
{
    Picture2 = new QWidget;
    Picture2->setObjectName(u"Picture2"_qs);
    Picture2->setAttribute(Qt::WA_StyledBackground);

    cmbCustomizationLevel = new QComboBox(Picture2);
    cmbCustomizationLevel->setObjectName(u"cmbCustomizationLevel"_qs);
    cmbCustomizationLevel->setToolTip(
        u"Select how much customization do you want. More level means more unique content"_qs);
    cmbIgnoreWords = new QComboBox(Picture2);
    cmbIgnoreWords->setObjectName(u"cmbIgnoreWords"_qs);
    cmbIgnoreWords->setToolTip(u"You can ignore words that are smaller than this number of alphabets."_qs);
    txtIgnoreWord = new QLineEdit(Picture2);
    txtIgnoreWord->setObjectName(u"txtIgnoreWord"_qs);
    lstIgnoreWords = new QTreeWidget(Picture2);
    lstIgnoreWords->setObjectName(u"lstIgnoreWords"_qs);
    lstIgnoreWords->setRootIsDecorated(false);
    lstIgnoreWords->setColumnCount(0);
    lstIgnoreWords->setMinimumWidth(IgnoredWordsColumnWidth + 24);

    cmdIgnoreWordsAdd = AddCommand(u"cmdIgnoreWordsAdd"_qs, u"Image19"_qs, u"     Add to list"_qs, Picture2,
                                   &frmMain::cmdIgnoreWordsAdd_Click);
    cmdIgnoreWordsRemove = AddCommand(u"cmdIgnoreWordsRemove"_qs, u"Image20"_qs, u"     Remove "_qs, Picture2,
                                      &frmMain::cmdIgnoreWordsRemove_Click);
    cmdIgnoreWordsClear = AddCommand(u"cmdIgnoreWordsClear"_qs, u"Image21"_qs, u"     Clear list"_qs, Picture2,
                                     &frmMain::cmdIgnoreWordsClear_Click);
    connect(txtIgnoreWord, &QLineEdit::returnPressed, this, &frmMain::cmdIgnoreWordsAdd_Click);

    auto *explainAlter = MakeLabel(u"The words that you add here will not be altered in the customized text. "
                                   "These words will be ignored for all processing."_qs,
                                   Picture2, u"lblExplain1"_qs);
    auto *explainSpaces = MakeLabel(u"Also make sure that the words DO NOT contain spaces or punctuation "
                                    "marks (,.:; etc)"_qs,
                                    Picture2, u"lblExplain2"_qs);
    auto *explainDensity = MakeLabel(u"You can use this to ensure that the keyword density of the articles "
                                     "that you are customizing is not changed."_qs,
                                     Picture2, u"lblExplain3"_qs);
    for (QLabel *label : {explainAlter, explainSpaces, explainDensity})
        label->setWordWrap(true);

    auto *settings = new QGridLayout;
    settings->setHorizontalSpacing(12);
    settings->setVerticalSpacing(8);
    settings->addWidget(MakeLabel(u"Customization Level:"_qs, Picture2), 0, 0);
    settings->addWidget(cmbCustomizationLevel, 0, 1);
    settings->addWidget(MakeLabel(u"Ignore words less than:"_qs, Picture2), 1, 0);
    settings->addWidget(cmbIgnoreWords, 1, 1);
    settings->setColumnStretch(2, 1);

    auto *side = new QVBoxLayout;
    side->setSpacing(8);
    side->addWidget(explainAlter);
    side->addWidget(explainSpaces);
    side->addWidget(explainDensity);
    side->addSpacing(6);
    side->addWidget(MakeLabel(u"Add new word:"_qs, Picture2));
    side->addWidget(txtIgnoreWord);
    side->addWidget(cmdIgnoreWordsAdd);
    side->addWidget(cmdIgnoreWordsRemove);
    side->addWidget(cmdIgnoreWordsClear);
    side->addStretch(1);

    auto *words = new QHBoxLayout;
    words->setSpacing(16);
    words->addWidget(lstIgnoreWords);
    words->addLayout(side, 1);

    auto *layout = new QVBoxLayout(Picture2);
    layout->setContentsMargins(18, 16, 18, 16);
    layout->setSpacing(14);
    layout->addLayout(settings);
    layout->addLayout(words, 1);
    return Picture2;
}

QWidget *frmMain::BuildVerifyPage()
{
    auto *page = new QFrame(this);
    page->setObjectName(u"pctMain(2)"_qs);
    page->setAttribute(Qt::WA_StyledBackground);
    txtVerifyTitle = new QLineEdit(page);
    txtVerifyTitle->setObjectName(u"txtVerifyTitle"_qs);
    txtVerifyTitle->setToolTip(u"Customized Title. Right click and select copy to copy this title"_qs);
    txtVerifyContents = new QPlainTextEdit(page);
    txtVerifyContents->setObjectName(u"txtVerifyContents"_qs);
    txtVerifyContents->setVerticalScrollBarPolicy(Qt::ScrollBarAlwaysOn);
    txtVerifyContents->setToolTip(u"Customized Content. Right click and select Copy to copy this content"_qs);

    auto *layout = new QGridLayout(page);
    layout->setContentsMargins(24, 16, 24, 16);
    layout->setHorizontalSpacing(12);
    layout->setVerticalSpacing(10);
    layout->addWidget(MakeLabel(u"Verify the Contents"_qs, page, u"lblVerify"_qs), 0, 0, 1, 2);
    auto *card = new QWidget(page);
    card->setObjectName(u"verifyCard"_qs);
    card->setAttribute(Qt::WA_StyledBackground);
    auto *cardLayout = new QGridLayout(card);
    cardLayout->setContentsMargins(18, 16, 18, 16);
    cardLayout->setHorizontalSpacing(12);
    cardLayout->setVerticalSpacing(10);
    cardLayout->addWidget(MakeLabel(u"Title:"_qs, card), 0, 0);
    cardLayout->addWidget(txtVerifyTitle, 0, 1);
    cardLayout->addWidget(MakeLabel(u"Contents:"_qs, card), 1, 0, Qt::AlignTop);
    cardLayout->addWidget(txtVerifyContents, 1, 1);
    cardLayout->setRowStretch(1, 1);
    layout->addWidget(card, 1, 0, 1, 2);
    layout->setRowStretch(1, 1);
    return page;
}

// ---------------------------------------------------------------------------------------------
// Loading and the pages

void frmMain::Form_Load()
{
    lblArticle->setVisible(true);
    lblConfiguration->setVisible(false);
    SetButton(false);

    const QString bannerUrl = ReadIniValue(u"URL"_qs, u"BANNER_URL"_qs, SettingsIniPath());
    if (bannerUrl.isEmpty())
        m_banner->ShowHtml(BannerHtml());
    else
        m_banner->Navigate(bannerUrl);

    BringPageToFront(1);
    m_panels->setCurrentWidget(Picture1);

    cmbCustomizationLevel->addItems(CustomizationLevelNames());
    cmbCustomizationLevel->setCurrentIndex(DefaultCustomizationLevel);
    cmbIgnoreWords->addItems({u"2 Letters"_qs, u"3 Letters"_qs, u"4 Letters"_qs, u"5 Letters"_qs});
    cmbIgnoreWords->setCurrentIndex(1);
    lstIgnoreWords->setHeaderLabels({u"Ignored Words"_qs});
    lstIgnoreWords->setColumnWidth(0, IgnoredWordsColumnWidth);

    m_currentPage = 0;
    BringPageToFront(0);
}

void frmMain::BringPageToFront(int index)
{
    switch (index) {
    case 0:
        // The wizard area lies inside the main page; the verify page keeps covering it.
        pctMain[0]->raise();
        break;
    case 1:
        pctMain[2]->hide();
        break;
    case 2:
        UpdateVerifyPageGeometry();
        pctMain[2]->show();
        pctMain[2]->raise();
        break;
    default:
        break;
    }
}

bool frmMain::VerifyPageInFront() const
{
    return !pctMain[2]->isHidden();
}

void frmMain::UpdateVerifyPageGeometry()
{
    QRect area(fraF->mapTo(this, QPoint(0, 0)), fraF->size());
    area.setBottom(cmdNext->mapTo(this, QPoint(0, 0)).y() - VerifyPageGap);
    pctMain[2]->setGeometry(area);
}

void frmMain::cmdArticle_Click()
{
    BringPageToFront(0);
    m_panels->setCurrentWidget(Picture1);
    lblArticle->setVisible(true);
    lblConfiguration->setVisible(false);
}

void frmMain::cmdConfig_Click()
{
    BringPageToFront(0);
    m_panels->setCurrentWidget(Picture2);
    lblArticle->setVisible(false);
    lblConfiguration->setVisible(true);
}

// ---------------------------------------------------------------------------------------------
// The wizard

bool frmMain::VerifyArticle()
{
    const std::optional<ArticleRefusal> refusal = VerifyArticleTexts(txtTitle->text(), txtArticle->toPlainText());
    if (!refusal)
        return true;
    m_ui.Say(this, refusal->Message);
    if (refusal->Field == ArticleField::Title)
        txtTitle->setFocus();
    else
        txtArticle->setFocus();
    return false;
}

void frmMain::AppendBlankIfMissing(QLineEdit *box)
{
    const QString text = box->text();
    if (text.isEmpty() || text.back() != QLatin1Char(' '))
        box->setText(text + QLatin1Char(' '));
}

void frmMain::AppendBlankIfMissing(QPlainTextEdit *box)
{
    const QString text = box->toPlainText();
    if (!text.isEmpty() && text.back() == QLatin1Char(' '))
        return;
    QTextCursor cursor(box->document());
    cursor.movePosition(QTextCursor::End);
    cursor.insertText(u" "_qs);
}

void frmMain::cmdNext_Click()
{
    if (cmdNext->Caption() == NextCaption) {
        // The suggestions window lets events through while it fills: a Next reached that way
        // must not start a second analysis inside the running one.
        if (m_analysisRunning)
            return;
        if (!VerifyArticle())
            return;
        m_webData->SetSilent(true);
        ++m_currentPage;
        cmdNext->SetCaption(GoBackCaption);
        if (m_currentPage == 1) {
            HideMainWindow();
            AppendBlankIfMissing(txtArticle);
            AppendBlankIfMissing(txtTitle);
            StopProcessing = false;
            m_analysisRunning = true;
            FillWordLists(txtTitle->text(), txtArticle->toPlainText(), CurrentArticle(), *m_suggestions, *this);
            m_analysisRunning = false;
        }
    } else {
        --m_currentPage;
        cmdNext->SetCaption(NextCaption);
    }
    SetButton(false);
    BringPageToFront(1);
    BringPageToFront(m_currentPage);
    ClearAll();
}

void frmMain::SetButton(bool bval)
{
    cmdVerifyTryAgain->Label()->setEnabled(bval);
    cmdVerifyTryAgain->Image()->setEnabled(bval);
    lblSaveAsSQLfile->Label()->setEnabled(bval);
    lblSaveAsSQLfile->Image()->setEnabled(bval);
    lblSaveAsxml->Image()->setEnabled(bval);
    lblSaveAsxml->Label()->setEnabled(bval);
    cmdSave->Label()->setEnabled(bval);
    cmdSave->Image()->setEnabled(bval);
    cmdGenerateSite->Label()->setEnabled(bval);
    cmdGenerateSite->Image()->setEnabled(bval);
}

void frmMain::ClearAll()
{
    cmdNext->Label()->setFrameShape(QFrame::NoFrame);
    cmdHelp->Label()->setFrameShape(QFrame::NoFrame);
}

void frmMain::cmdVerifyTryAgain_Click()
{
    const WordStore store(ProgramFolder());
    WordFileAlternatives source(store);
    Spinner spinner(CurrentArticle(), CurrentSpinSettings(), source, ProcessRandom());
    txtVerifyTitle->setText(spinner.SpinTitle());
    txtVerifyTitle->setCursorPosition(0);
    txtVerifyContents->setPlainText(spinner.SpinContents());
}

// ---------------------------------------------------------------------------------------------
// The host of the suggestions window

WordTestSettings frmMain::CurrentWordTestSettings() const
{
    WordTestSettings settings;
    settings.MinimumWordLength = cmbIgnoreWords->currentIndex() + 2;
    for (int i = 0; i < lstIgnoreWords->topLevelItemCount(); ++i)
        settings.IgnoredWords.append(lstIgnoreWords->topLevelItem(i)->text(0));
    return settings;
}

SpinSettings frmMain::CurrentSpinSettings() const
{
    SpinSettings settings;
    settings.WordTest = CurrentWordTestSettings();
    settings.CustomizationLevel = cmbCustomizationLevel->currentIndex();
    return settings;
}

PageSource &frmMain::LookupPage()
{
    return *m_lookupPage;
}

QString frmMain::ThesaurusHost() const
{
    return m_thesaurusHost;
}

void frmMain::ShowWaitWindow()
{
    if (!m_wait)
        m_wait = new frmWait(this);
    m_wait->show();
    m_wait->raise();
}

void frmMain::UnloadWaitWindow()
{
    delete m_wait;
    m_wait = nullptr;
}

void frmMain::HideMainWindow()
{
    hide();
}

void frmMain::ShowMainWindow()
{
    show();
    raise();
    activateWindow();
}

void frmMain::ShowVerifyPage()
{
    BringPageToFront(2);
}

// ---------------------------------------------------------------------------------------------
// Commands

void frmMain::cmdSave_Click()
{
    UiServices::FileDialog dialog;
    dialog.Title = u"Save this content"_qs;
    dialog.Filter = TextFileFilter;
    dialog.DefaultSuffix = u"txt"_qs;
    const QString path = m_ui.GetSaveFileName(this, dialog);
    if (path.isEmpty())
        return;
    const QString text = txtVerifyTitle->text() + CrLf + CrLf + NormalizeToCrLf(txtVerifyContents->toPlainText());
    if (!WriteTextFile(path, text)) {
        m_ui.Say(this, u"The file could not be saved as "_qs + path + CrLf
                     + u"Please choose another name or folder."_qs,
                 UiServices::Icon::Critical);
        return;
    }
    if (m_ui.Show(this, FileSavedQuestion(path)) == UiServices::Answer::Yes)
        m_ui.OpenWithShell(path);
}

void frmMain::cmdHelp_Click()
{
    const QString path = ProgramPath(u"Help/Verbloom_Help.htm"_qs);
    if (!m_ui.OpenWithShell(path))
        m_ui.Say(this, u"The help page could not be opened: "_qs + path, UiServices::Icon::Exclamation);
}

// The export and site windows open from these commands once they exist.
void frmMain::lblSaveAsxml_Click() {}
void frmMain::lblSaveAsSQLfile_Click() {}
void frmMain::cmdGenerateSite_Click() {}

void frmMain::cmdBrowseURL_Click()
{
    frmOpenURL loader(*txtTitle, *txtArticle, m_ui, this);
    loader.exec();
}

void frmMain::cmdBrowseTextFile_Click()
{
    UiServices::FileDialog dialog;
    dialog.Title = u"Select a text file to open"_qs;
    dialog.Filter = TextFileFilter;
    dialog.DefaultSuffix = u"txt"_qs;
    const QString path = m_ui.GetOpenFileName(this, dialog);
    if (path.isEmpty())
        return;
    QString text;
    if (!TryReadTextFile(path, text)) {
        m_ui.Say(this, u"The file could not be read: "_qs + path, UiServices::Icon::Critical);
        return;
    }
    txtArticle->setPlainText(text);
}

void frmMain::cmdIgnoreWordsAdd_Click()
{
    const QString word = txtIgnoreWord->text();
    const int minimumLength = cmbIgnoreWords->currentIndex() + 2;
    if (const std::optional<QString> refusal = CheckIgnoredWord(word, minimumLength)) {
        m_ui.Say(this, *refusal);
        return;
    }
    auto *item = new QTreeWidgetItem(lstIgnoreWords);
    item->setText(0, word);
    txtIgnoreWord->clear();
}

void frmMain::cmdIgnoreWordsRemove_Click()
{
    const QList<QTreeWidgetItem *> selected = lstIgnoreWords->selectedItems();
    if (selected.isEmpty()) {
        m_ui.Say(this, u"Please select a word from the list on the left"_qs);
        return;
    }
    QTreeWidgetItem *item = selected.constFirst();
    if (m_ui.Say(this, u"Are you sure you want to remove the word \""_qs + item->text(0)
                           + u"\" from the Ignored Words List"_qs,
                 UiServices::Icon::Information, UiServices::Buttons::YesNo)
        == UiServices::Answer::Yes)
        delete item;
}

void frmMain::cmdIgnoreWordsClear_Click()
{
    if (m_ui.Say(this, u"Are you sure you want to remove ALL THE WORDS from the list"_qs,
                 UiServices::Icon::Information, UiServices::Buttons::YesNo)
        == UiServices::Answer::Yes)
        lstIgnoreWords->clear();
}

void frmMain::Command1_Click()
{
    txtArticle->clear();
    const QFileInfoList files = QDir(ProgramPath(u"data"_qs)).entryInfoList(QDir::Files, QDir::Name);
    for (const QFileInfo &file : files) {
        QCoreApplication::processEvents();
        if (file.size() != 0)
            continue;
        QTextCursor cursor(txtArticle->document());
        cursor.movePosition(QTextCursor::End);
        cursor.insertText(QLatin1Char(' ') + file.fileName().chopped(qMin<qsizetype>(4, file.fileName().size())));
    }
}

// ---------------------------------------------------------------------------------------------
// Events

void frmMain::ResetSkins(std::initializer_list<ImageCommand *> commands)
{
    for (ImageCommand *command : commands)
        command->SetSkin(BlueSkin);
}

bool frmMain::eventFilter(QObject *watched, QEvent *event)
{
    const QEvent::Type type = event->type();
    if ((watched == fraF || watched == cmdNext) && (type == QEvent::Resize || type == QEvent::Move))
        UpdateVerifyPageGeometry();
    if (type != QEvent::MouseMove)
        return QWidget::eventFilter(watched, event);

    if (watched == fraButtons) {
        ResetSkins({cmdVerifyTryAgain, lblSaveAsSQLfile, lblSaveAsxml, cmdSave, cmdGenerateSite, cmdHelp,
                    cmdConfig, cmdArticle});
    } else if (watched == Picture1) {
        ResetSkins({cmdBrowseTextFile, cmdBrowseURL});
    } else if (watched == Picture2) {
        ResetSkins({cmdIgnoreWordsAdd, cmdIgnoreWordsRemove, cmdIgnoreWordsClear});
    } else if (watched == pctMain[0] || watched == pctMain[1] || watched == pctMain[2]) {
        ResetSkins({cmdNext});
    } else if (watched == this) {
        ClearAll();
    } else if (watched != fraF) {
        return QWidget::eventFilter(watched, event);
    }
    return true; // a background takes its own mouse moves
}

void frmMain::showEvent(QShowEvent *event)
{
    QWidget::showEvent(event);
    UpdateVerifyPageGeometry();
    if (!m_shownOnce) {
        m_shownOnce = true;
        if (!m_startupNotice.isEmpty())
            QTimer::singleShot(0, this, [this] { m_ui.Say(this, m_startupNotice, UiServices::Icon::Exclamation); });
    }
}

void frmMain::closeEvent(QCloseEvent *event)
{
    // Closing the main window ends the program at once; nothing is asked or saved.
    StopProcessing = true;
    m_suggestions->hide();
    UnloadWaitWindow();
    event->accept();
    QCoreApplication::quit();
}

} // namespace verbloom
