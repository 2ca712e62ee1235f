#pragma once

#include "engine/SpinGenerator.h"
#include "shell/ArticleModel.h"

#include <QString>

namespace verbloom {

class PageSource;

/// The main window as the suggestions window reaches it.
class SuggestionsHost : public WizardHost
{
public:
    /// The word test's settings as the main window's controls stand now.
    virtual WordTestSettings CurrentWordTestSettings() const = 0;
    /// The spin settings (word test and customization level) as the controls stand now.
    virtual SpinSettings CurrentSpinSettings() const = 0;
    /// The browser the lookups load their pages in (webData).
    virtual PageSource &LookupPage() = 0;
    /// The thesaurus address, such as "http://127.0.0.1:8080"; empty when none is available.
    virtual QString ThesaurusHost() const = 0;
    virtual void ShowWaitWindow() = 0;     ///< frmWait with "Please Wait ....."
    virtual void HideMainWindow() = 0;
    virtual void ShowVerifyPage() = 0;     ///< bring the verify page to the front
    virtual void cmdVerifyTryAgain_Click() = 0;
    /// True while "Next" is filling the word lists.
    virtual bool AnalysisRunning() const = 0;
};

} // namespace verbloom
