#pragma once

#include "splitter/SplitterMessageSink.h"

namespace verbloom {

class UiServices;

/// Shows the splitter's error box through the program's message boxes.
class SplitterMessageBox final : public SplitterMessageSink
{
public:
    explicit SplitterMessageBox(UiServices &ui);
    SplitterAnswer ShowSplitterMessage(const QString &prompt, bool designMode) override;

private:
    UiServices &m_ui;
};

} // namespace verbloom
