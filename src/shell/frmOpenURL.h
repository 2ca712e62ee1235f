#pragma once

#include <QDialog>

class QLabel;
class QLineEdit;
class QPlainTextEdit;
class QProgressBar;
class QStatusBar;

namespace verbloom {

class Browser;
class ImageCommand;
class UiServices;

/// "Open URL to customize": loads a web page and puts its title and body text into the main
/// window's article boxes, then closes. The close box abandons a page that never completes.
class frmOpenURL final : public QDialog
{
    Q_OBJECT

public:
    /// The shortest address "Get Contents" accepts.
    static constexpr qsizetype MinimumUrlLength = 16;

    frmOpenURL(QLineEdit &title, QPlainTextEdit &contents, UiServices &ui, QWidget *parent = nullptr);
    ~frmOpenURL() override;

    Browser &WebBrowser1() { return *m_browser; }

    void cmdGet_Click();

protected:
    bool eventFilter(QObject *watched, QEvent *event) override;

private:
    void Form_Load();
    void WebBrowser1_StatusTextChange(const QString &text);
    void WebBrowser1_ProgressChange(int progress, int progressMax);
    void WebBrowser1_DocumentComplete();

    QLineEdit &m_title;
    QPlainTextEdit &m_contents;
    UiServices &m_ui;
    Browser *m_browser = nullptr;
    bool m_completed = false;

    QWidget *Picture1 = nullptr;
    QLineEdit *txturl = nullptr;
    ImageCommand *cmdGet = nullptr;
    QProgressBar *ProgressBar1 = nullptr;
    QStatusBar *StatusBar1 = nullptr;
    QLabel *m_msgPanel = nullptr; ///< the status bar's panel "msg"
};

} // namespace verbloom
