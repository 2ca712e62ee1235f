#pragma once

#include <QElapsedTimer>
#include <QString>

namespace verbloom {

/// The batch tool's terminal: messages on stderr, results on stdout, and a progress line on
/// stderr that appears only when stderr is a terminal and the work has lasted a while.
class BatchConsole final
{
public:
    /// `showProgress`: whether progress may be drawn (normally: stderr is a terminal).
    explicit BatchConsole(bool showProgress);
    ~BatchConsole();
    BatchConsole(const BatchConsole &) = delete;
    BatchConsole &operator=(const BatchConsole &) = delete;

    /// True when stderr is a terminal.
    static bool StderrIsTerminal();

    /// "verbloom-batch: " + the message on stderr; CR LF line breaks are written as LF.
    void Error(const QString &message);
    /// Text on stdout, as it stands.
    void Print(const QString &text);
    /// Text on stderr, as it stands.
    void PrintError(const QString &text);

    /// Updates the progress line ("what: done of total"), at most ten times a second.
    void Progress(const QString &what, qsizetype done, qsizetype total);
    /// Removes the progress line, if one is shown.
    void ClearProgress();

private:
    bool m_showProgress;
    bool m_shown = false;
    qsizetype m_shownWidth = 0;
    QElapsedTimer m_started;
    QElapsedTimer m_lastDrawn;
};

} // namespace verbloom
