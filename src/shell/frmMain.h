#pragma once

#include "engine/SuggestionsHost.h"

#include <QString>
#include <QWidget>

#include <memory>

class QComboBox;
class QFrame;
class QLabel;
class QLineEdit;
class QPlainTextEdit;
class QPushButton;
class QStackedLayout;
class QTreeWidget;

namespace verbloom {

class BrowserPageSource;
class ImageCommand;
class UiServices;
class WebEngineBrowser;
class frmSuggestions;
class frmWait;

/// The main window and hub of the wizard: the banner, the button bar, the article entry and
/// configuration panels, the verify page, and the browser the thesaurus lookups use.
class frmMain final : public QWidget, public SuggestionsHost
{
    Q_OBJECT

public:
    /// Caption of the wizard button in the entry state; the wizard step compares against it.
    static const QString NextCaption;
    /// Caption of the wizard button while an article is analysed or verified.
    static const QString GoBackCaption;

    /// Loads the window (hidden): buttons off, banner requested, settings filled, entry page.
    frmMain(UiServices &ui, const QString &thesaurusHost, QWidget *parent = nullptr);
    ~frmMain() override;

    // Public methods of the window, in their order.
    void cmdNext_Click() override;
    void cmdVerifyTryAgain_Click() override;
    void ClearAll();
    void SetButton(bool bval) override;

    /// "Next"'s check: a title and contents that are not blank. Messages and focus on failure.
    bool VerifyArticle();

    // SuggestionsHost
    WordTestSettings CurrentWordTestSettings() const override;
    SpinSettings CurrentSpinSettings() const override;
    PageSource &LookupPage() override;
    QString ThesaurusHost() const override;
    void ShowWaitWindow() override;
    void UnloadWaitWindow() override;
    void HideMainWindow() override;
    void ShowMainWindow() override;
    void ShowVerifyPage() override;
    bool AnalysisRunning() const override { return m_analysisRunning; }

    int CurrentPage() const { return m_currentPage; }
    /// True while the verify page lies in front of the main page.
    bool VerifyPageInFront() const;
    frmSuggestions &Suggestions() { return *m_suggestions; }
    /// The hidden lookup browser webData.
    WebEngineBrowser &webData() { return *m_webData; }
    /// The banner browser WebBrowser1.
    WebEngineBrowser &WebBrowser1() { return *m_banner; }
    /// A problem found at start-up, shown once when the window first appears.
    void SetStartupNotice(const QString &text) { m_startupNotice = text; }

    // Handlers.
    void cmdArticle_Click();
    void cmdConfig_Click();
    void cmdSave_Click();
    void cmdHelp_Click();
    void lblSaveAsxml_Click();
    void lblSaveAsSQLfile_Click();
    void cmdGenerateSite_Click();
    void cmdBrowseURL_Click();
    void cmdBrowseTextFile_Click();
    void cmdIgnoreWordsAdd_Click();
    void cmdIgnoreWordsRemove_Click();
    void cmdIgnoreWordsClear_Click();
    void Command1_Click();

    // Controls other windows read and write.
    QLineEdit *txtTitle = nullptr;
    QPlainTextEdit *txtArticle = nullptr;
    QComboBox *cmbCustomizationLevel = nullptr;
    QComboBox *cmbIgnoreWords = nullptr;
    QTreeWidget *lstIgnoreWords = nullptr;
    QTreeWidget *lstArticles = nullptr;

protected:
    void closeEvent(QCloseEvent *event) override;
    void showEvent(QShowEvent *event) override;
    bool eventFilter(QObject *watched, QEvent *event) override;

private:
    void Form_Load();
    void BuildWindow();
    QWidget *BuildButtonBar();
    QWidget *BuildArticlePanel();
    QWidget *BuildConfigurationPanel();
    QWidget *BuildVerifyPage();
    ImageCommand *AddCommand(const QString &labelName, const QString &imageName, const QString &caption,
                             QWidget *parent, void (frmMain::*handler)(), bool labelHighlights = true);
    /// Brings page 0 (wizard area), 1 (main page) or 2 (verify page) of pctMain to the front.
    void BringPageToFront(int index);
    void UpdateVerifyPageGeometry();
    void ResetSkins(std::initializer_list<ImageCommand *> commands);
    void AppendBlankIfMissing(QLineEdit *box);
    void AppendBlankIfMissing(QPlainTextEdit *box);

    UiServices &m_ui;
    QString m_thesaurusHost;
    QString m_startupNotice;
    int m_currentPage = 0;
    bool m_analysisRunning = false;
    bool m_shownOnce = false;
    WebEngineBrowser *m_banner = nullptr;
    WebEngineBrowser *m_webData = nullptr;
    std::unique_ptr<BrowserPageSource> m_lookupPage;
    frmSuggestions *m_suggestions = nullptr;
    frmWait *m_wait = nullptr;

    QWidget *Picture3 = nullptr;
    QWidget *pctMain[3] = {nullptr, nullptr, nullptr};
    QFrame *fraButtons = nullptr;
    QFrame *fraF = nullptr;
    QLabel *lblArticle = nullptr;
    QLabel *lblConfiguration = nullptr;
    QStackedLayout *m_panels = nullptr;
    QWidget *Picture1 = nullptr;
    QWidget *Picture2 = nullptr;
    QPushButton *Command1 = nullptr;
    QLineEdit *txtIgnoreWord = nullptr;
    QLineEdit *txtVerifyTitle = nullptr;
    QPlainTextEdit *txtVerifyContents = nullptr;

    ImageCommand *cmdArticle = nullptr;
    ImageCommand *cmdConfig = nullptr;
    ImageCommand *cmdVerifyTryAgain = nullptr;
    ImageCommand *lblSaveAsxml = nullptr;
    ImageCommand *lblSaveAsSQLfile = nullptr;
    ImageCommand *cmdHelp = nullptr;
    ImageCommand *cmdGenerateSite = nullptr;
    ImageCommand *cmdSave = nullptr;
    ImageCommand *cmdNext = nullptr;
    ImageCommand *cmdBrowseURL = nullptr;
    ImageCommand *cmdBrowseTextFile = nullptr;
    ImageCommand *cmdIgnoreWordsAdd = nullptr;
    ImageCommand *cmdIgnoreWordsRemove = nullptr;
    ImageCommand *cmdIgnoreWordsClear = nullptr;
};

} // namespace verbloom
