#include "batch/BatchConsole.h"

#include <algorithm>
#include <cstdio>

#include <unistd.h>

namespace verbloom {

namespace {

// The progress line appears only after this long, so quick runs print nothing extra.
constexpr qint64 kQuietMs = 500;
constexpr qint64 kRedrawMs = 100;

void Write(std::FILE *stream, const QString &text)
{
    const QByteArray bytes = text.toUtf8();
    std::fwrite(bytes.constData(), 1, size_t(bytes.size()), stream);
    std::fflush(stream);
}

} // namespace

BatchConsole::BatchConsole(bool showProgress)
    : m_showProgress(showProgress)
{
    m_started.start();
}

BatchConsole::~BatchConsole()
{
    ClearProgress();
}

bool BatchConsole::StderrIsTerminal()
{
    return ::isatty(STDERR_FILENO) == 1;
}

void BatchConsole::Error(const QString &message)
{
    ClearProgress();
    QString text = message;
    text.replace(u"\r\n"_qs, u"\n"_qs);
    Write(stderr, u"verbloom-batch: "_qs + text + QLatin1Char('\n'));
}

void BatchConsole::Print(const QString &text)
{
    ClearProgress();
    Write(stdout, text);
}

void BatchConsole::PrintError(const QString &text)
{
    ClearProgress();
    Write(stderr, text);
}

void BatchConsole::Progress(const QString &what, qsizetype done, qsizetype total)
{
    if (!m_showProgress || m_started.elapsed() < kQuietMs)
        return;
    if (m_shown && m_lastDrawn.elapsed() < kRedrawMs && done != total)
        return;
    const QString line = what + u": "_qs + QString::number(done) + u" of "_qs + QString::number(total);
    const qsizetype pad = std::max<qsizetype>(0, m_shownWidth - line.size());
    Write(stderr, QLatin1Char('\r') + line + QString(pad, QLatin1Char(' ')));
    m_shown = true;
    m_shownWidth = line.size();
    m_lastDrawn.start();
}

void BatchConsole::ClearProgress()
{
    if (!m_shown)
        return;
    Write(stderr, QLatin1Char('\r') + QString(m_shownWidth, QLatin1Char(' ')) + QLatin1Char('\r'));
    m_shown = false;
    m_shownWidth = 0;
}

} // namespace verbloom
