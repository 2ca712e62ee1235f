#pragma once

#include <QObject>
#include <QString>

class QWidget;

namespace verbloom {

/// The embedded web browser as the windows use it: navigate and stop, the ready states, the
/// document's texts and title, and the loading events. Texts are collected when a page has
/// finished loading; only then does the browser report itself complete.
class Browser : public QObject
{
    Q_OBJECT

public:
    /// ReadyState() once the page and its texts are there.
    static constexpr int ReadyStateComplete = 4;

    using QObject::QObject;
    ~Browser() override = default;

    /// The widget that shows the page.
    virtual QWidget *View() const = 0;

    /// Starts loading a web address or a local file path; returns at once.
    virtual void Navigate(const QString &address) = 0;
    /// Ends any loading in progress; a following Navigate starts cleanly.
    virtual void Stop() = 0;
    /// No dialog boxes of the page (alerts, confirmations, prompts) while silent.
    virtual void SetSilent(bool silent) = 0;

    /// 0 uninitialized, 1 loading, 4 complete.
    virtual int ReadyState() const = 0;
    /// "uninitialized", "loading" or "complete".
    virtual QString DocumentReadyState() const = 0;

    /// The rendered text of the document's root element, lines joined with CR LF.
    virtual QString RootInnerText() const = 0;
    /// The rendered text of the document's body, lines joined with CR LF.
    virtual QString BodyInnerText() const = 0;
    /// False when the completed document has no body (a frame set).
    virtual bool HasBody() const = 0;
    /// The page's title; its address when it has none.
    virtual QString LocationName() const = 0;

signals:
    void statusTextChanged(const QString &text);
    void progressChanged(int progress, int progressMax);
    /// The page has loaded and its texts are collected.
    void documentComplete();
    void titleChanged(const QString &title);
};

} // namespace verbloom
