#include "SplitterMessageSink.h"

#include <QtGlobal>

#include <cstdio>
#include <cstdlib>

namespace verbloom {

namespace {

class LogMessageSink final : public SplitterMessageSink
{
public:
    SplitterAnswer ShowSplitterMessage(const QString &prompt, bool designMode) override
    {
        qWarning("%ls: %ls", qUtf16Printable(kSplitterMessageTitle.toString()),
                 qUtf16Printable(prompt));
        return designMode ? SplitterAnswer::No : SplitterAnswer::Ok;
    }
};

LogMessageSink g_logSink;
SplitterMessageSink *g_sink = &g_logSink;

} // namespace

void SplitterMessageSink::EndProgram()
{
    std::fflush(nullptr);
    std::_Exit(EXIT_FAILURE);
}

SplitterMessageSink *SetSplitterMessageSink(SplitterMessageSink *sink)
{
    SplitterMessageSink *previous = g_sink;
    g_sink = sink ? sink : &g_logSink;
    return previous;
}

SplitterMessageSink &CurrentSplitterMessageSink()
{
    return *g_sink;
}

} // namespace verbloom
