#pragma once

#include <QString>
#include <QStringView>

namespace verbloom {

/// Title of the splitter's error box.
inline constexpr QStringView kSplitterMessageTitle = u"clsSplitExtra Message";

/// The answer given to the splitter's error box.
enum class SplitterAnswer { Ok, Yes, No };

/// Shows the splitter's error box. In design mode the box asks Yes/No (No is the default button,
/// exclamation icon); otherwise it only offers OK (exclamation icon). The title is
/// kSplitterMessageTitle.
class SplitterMessageSink
{
public:
    virtual ~SplitterMessageSink() = default;

    /// Shows `prompt` and returns the user's answer.
    virtual SplitterAnswer ShowSplitterMessage(const QString &prompt, bool designMode) = 0;

    /// Called after a design-mode Yes: ends the program at once. Tests override it.
    virtual void EndProgram();
};

/// Installs the process-wide sink and returns the previous one; nullptr restores the default,
/// which writes the prompt to the warning log and answers No (OK outside design mode).
/// The sink is not owned.
SplitterMessageSink *SetSplitterMessageSink(SplitterMessageSink *sink);

/// The sink in use.
SplitterMessageSink &CurrentSplitterMessageSink();

} // namespace verbloom
