#pragma once

#include "engine/ThesaurusLookup.h"

namespace verbloom {

class Browser;

/// The thesaurus lookup's page loader over an embedded browser (the main window's webData).
class BrowserPageSource final : public PageSource
{
public:
    explicit BrowserPageSource(Browser &browser);

    void Stop() override;
    void Navigate(const QString &url) override;
    /// Runs a local event loop until the browser reports complete and its document is
    /// "complete"; false after timeoutMs, or early when StopProcessing is set.
    bool WaitUntilComplete(int timeoutMs) override;
    QString PageText() override;

private:
    bool IsComplete() const;

    Browser &m_browser;
};

} // namespace verbloom
