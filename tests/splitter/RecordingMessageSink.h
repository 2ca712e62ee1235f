#pragma once

#include "splitter/SplitterMessageSink.h"

#include <QList>
#include <QStringList>

namespace verbloom {

/// Records the splitter's error boxes and answers them as told; installed for its lifetime.
class RecordingMessageSink final : public SplitterMessageSink
{
public:
    RecordingMessageSink() : m_previous(SetSplitterMessageSink(this)) {}
    ~RecordingMessageSink() override { SetSplitterMessageSink(m_previous); }
    RecordingMessageSink(const RecordingMessageSink &) = delete;
    RecordingMessageSink &operator=(const RecordingMessageSink &) = delete;

    SplitterAnswer ShowSplitterMessage(const QString &prompt, bool designMode) override
    {
        m_prompts.append(prompt);
        m_designModes.append(designMode);
        return m_answer;
    }
    void EndProgram() override { ++m_endRequests; }

    void SetAnswer(SplitterAnswer answer) { m_answer = answer; }
    const QStringList &Prompts() const { return m_prompts; }
    const QList<bool> &DesignModes() const { return m_designModes; }
    int EndRequests() const { return m_endRequests; }

    /// The prompt of an error of `routine` in design mode.
    static QString DesignPrompt(const QString &routine, const QString &message)
    {
        return QStringLiteral("Accessing Routine: '") + routine + QStringLiteral("'\r\n") + message
            + QStringLiteral("\r\n\r\nBreak to Examine Call Stack?");
    }

private:
    SplitterMessageSink *m_previous;
    QStringList m_prompts;
    QList<bool> m_designModes;
    SplitterAnswer m_answer = SplitterAnswer::No;
    int m_endRequests = 0;
};

} // namespace verbloom
