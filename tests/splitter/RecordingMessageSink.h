#pragma once

#include "splitter/SplitterMessageSink.h"

#include <QList>
#include <QString>

namespace verbloom {

/// Records the splitter's error boxes and answers them as told; installed for its lifetime.
class RecordingMessageSink final : public SplitterMessageSink
{
public:
    struct Shown
    {
        QString Prompt;
        bool DesignMode = false;
    };

    RecordingMessageSink() : m_previous(SetSplitterMessageSink(this)) {}
    ~RecordingMessageSink() override { SetSplitterMessageSink(m_previous); }
    RecordingMessageSink(const RecordingMessageSink &) = delete;
    RecordingMessageSink &operator=(const RecordingMessageSink &) = delete;

    SplitterAnswer ShowSplitterMessage(const QString &prompt, bool designMode) override
    {
        m_shown.append({prompt, designMode});
        return m_answer;
    }
    void EndProgram() override { ++m_endRequests; }

    void SetAnswer(SplitterAnswer answer) { m_answer = answer; }
    const QList<Shown> &ShownBoxes() const { return m_shown; }
    QStringList Prompts() const
    {
        QStringList prompts;
        for (const Shown &shown : m_shown)
            prompts.append(shown.Prompt);
        return prompts;
    }
    int EndRequests() const { return m_endRequests; }
    void Clear()
    {
        m_shown.clear();
        m_endRequests = 0;
    }

    /// The prompt of an error of `routine` in design mode.
    static QString DesignPrompt(const QString &routine, const QString &message)
    {
        return PlainPrompt(routine, message) + QStringLiteral("\r\nBreak to Examine Call Stack?");
    }
    /// The prompt of an error of `routine` outside design mode.
    static QString PlainPrompt(const QString &routine, const QString &message)
    {
        return QStringLiteral("Accessing Routine: '") + routine + QStringLiteral("'\r\n") + message
            + QStringLiteral("\r\n");
    }

private:
    SplitterMessageSink *m_previous;
    QList<Shown> m_shown;
    SplitterAnswer m_answer = SplitterAnswer::No;
    int m_endRequests = 0;
};

} // namespace verbloom
