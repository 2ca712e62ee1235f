#include "frmOpenURL.h"

#include "ImageCommand.h"
#include "UiServices.h"
#include "WebEngineBrowser.h"

#include <QEvent>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QProgressBar>
#include <QStatusBar>
#include <QVBoxLayout>

namespace verbloom {

frmOpenURL::frmOpenURL(QLineEdit &title, QPlainTextEdit &contents, UiServices &ui, QWidget *parent)
    : QDialog(parent)
    , m_title(title)
    , m_contents(contents)
    , m_ui(ui)
{
    setObjectName(u"frmOpenURL"_qs);
    setWindowTitle(u"Open URL to customize"_qs);
    setModal(true);

    Picture1 = new QWidget(this);
    Picture1->setObjectName(u"Picture1"_qs);
    Picture1->setMouseTracking(true);
    Picture1->installEventFilter(this);
    auto *prompt = new QLabel(u"Enter a URL to get contents from"_qs, Picture1);
    prompt->setObjectName(u"lblPrompt"_qs);
    txturl = new QLineEdit(Picture1);
    txturl->setObjectName(u"txturl"_qs);
    auto *note = new QLabel(
        u"(Note:- Please make sure that the URL starts with \"http://\" or \"https://\" )"_qs, Picture1);
    note->setObjectName(u"lblNote"_qs);
    note->setWordWrap(true);
    cmdGet = new ImageCommand(u"Label4"_qs, u"cmdGet"_qs, u"Get Contents"_qs, PicSkin, Picture1);
    cmdGet->SetHoverSkin(PicHoverSkin);
    connect(cmdGet, &ImageCommand::clicked, this, &frmOpenURL::cmdGet_Click);
    connect(txturl, &QLineEdit::returnPressed, this, &frmOpenURL::cmdGet_Click);

    auto *panelLayout = new QGridLayout(Picture1);
    panelLayout->setContentsMargins(16, 14, 16, 10);
    panelLayout->setHorizontalSpacing(10);
    panelLayout->addWidget(prompt, 0, 0, 1, 2);
    panelLayout->addWidget(txturl, 1, 0);
    panelLayout->addWidget(cmdGet, 1, 1);
    panelLayout->addWidget(note, 2, 0, 1, 2);
    panelLayout->setColumnStretch(0, 1);

    ProgressBar1 = new QProgressBar(this);
    ProgressBar1->setObjectName(u"ProgressBar1"_qs);
    ProgressBar1->setTextVisible(false);
    ProgressBar1->setMaximumHeight(6);
    ProgressBar1->setValue(0);

    auto *webBrowser = new WebEngineBrowser(this);
    m_browser = webBrowser;
    m_browser->setObjectName(u"WebBrowser1"_qs);
    m_browser->View()->setObjectName(u"WebBrowser1View"_qs);
    m_browser->View()->setMinimumHeight(220);
    connect(m_browser, &Browser::statusTextChanged, this, &frmOpenURL::WebBrowser1_StatusTextChange);
    connect(m_browser, &Browser::progressChanged, this, &frmOpenURL::WebBrowser1_ProgressChange);
    connect(m_browser, &Browser::documentComplete, this, &frmOpenURL::WebBrowser1_DocumentComplete);

    StatusBar1 = new QStatusBar(this);
    StatusBar1->setObjectName(u"StatusBar1"_qs);
    StatusBar1->setSizeGripEnabled(false);
    m_msgPanel = new QLabel(StatusBar1);
    m_msgPanel->setObjectName(u"msg"_qs);
    StatusBar1->addWidget(m_msgPanel, 1);

    auto *layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setSpacing(0);
    layout->addWidget(Picture1);
    layout->addWidget(ProgressBar1);
    layout->addWidget(m_browser->View(), 1);
    layout->addWidget(StatusBar1);
    resize(620, 440);

    Form_Load();
}

frmOpenURL::~frmOpenURL() = default;

void frmOpenURL::Form_Load()
{
    m_browser->Stop();
    txturl->setText(u"http://"_qs);
}

void frmOpenURL::cmdGet_Click()
{
    const QString address = txturl->text();
    if (address.size() < MinimumUrlLength) {
        m_ui.Say(this, u"Please enter valid URL!!!"_qs, UiServices::Icon::Critical);
        return;
    }
    m_browser->Navigate(address);
}

void frmOpenURL::WebBrowser1_StatusTextChange(const QString &text)
{
    m_msgPanel->setText(text);
}

void frmOpenURL::WebBrowser1_ProgressChange(int progress, int progressMax)
{
    if (progress >= 0 && progressMax > progress) {
        ProgressBar1->setMaximum(progressMax);
        ProgressBar1->setValue(progress);
    }
}

void frmOpenURL::WebBrowser1_DocumentComplete()
{
    // Only the first completed document counts; a frame set without a body leaves the article alone.
    if (m_completed || !m_browser->HasBody())
        return;
    m_completed = true;
    m_title.setText(m_browser->LocationName());
    m_contents.setPlainText(m_browser->BodyInnerText());
    accept();
}

bool frmOpenURL::eventFilter(QObject *watched, QEvent *event)
{
    if (watched == Picture1 && event->type() == QEvent::MouseMove)
        cmdGet->SetSkin(PicSkin);
    return QDialog::eventFilter(watched, event);
}

} // namespace verbloom
