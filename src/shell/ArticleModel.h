#pragma once

#include <QString>
#include <QStringList>

namespace verbloom {

/// True from start-up; cleared just before an analysis runs, set by Cancel in the suggestions
/// window. The contents loop of FillWordLists stops while it is set.
extern bool StopProcessing;

/// What the word test reads from the main window at the moment of the call.
struct WordTestSettings
{
    int MinimumWordLength = 3; ///< index of "Ignore words less than" + 2
    QStringList IgnoredWords;  ///< lstIgnoreWords, in list order
};

/// The word test: true only when the token may be replaced. In this order: longer than the
/// minimum word length, not numeric, no digit, none of "@#=%$^*&" and U+2026, and, upper-cased,
/// different from every ignored word upper-cased.
bool IsCustomizableWord(const QString &token, const WordTestSettings &settings);

/// The article model: one element per token in text order. Delimiter characters are tokens of
/// their own; joining the elements gives back the text.
struct ArticleTokens
{
    QStringList TitleTokens;
    QStringList ContentsTokens;
};

/// The 28 delimiters of an article, in the order they are registered.
const QStringList &ArticleDelimiters();

/// Splits the title as it stands and the contents with every CR LF and lone CR turned into LF.
ArticleTokens SplitArticle(const QString &title, const QString &contents);

/// The article model of the running program: the last analysis (empty before the first).
ArticleTokens &CurrentArticle();

/// The suggestions window as FillWordLists drives it.
class SuggestionsView
{
public:
    virtual ~SuggestionsView() = default;
    virtual void ShowModeless() = 0;
    virtual void ClearLists() = 0;                           ///< both lstSuggestions(0) and (1)
    virtual void SetStatusVisible(bool visible) = 0;         ///< pctStatus
    virtual void SetProgressMaximum(qsizetype maximum) = 0;  ///< pBar
    virtual void SetProgressValue(qsizetype value) = 0;
    virtual void SetWordCaption(const QString &caption) = 0; ///< lblWord
    virtual void SelectContentsTab() = 0;                    ///< SSTab1 tab 1
    virtual void AddItems(const QString &word, int list) = 0;
    virtual void Unload() = 0;
};

/// The main window in the cancel path of FillWordLists.
class WizardHost
{
public:
    virtual ~WizardHost() = default;
    virtual void cmdNext_Click() = 0;
    virtual void SetButton(bool enabled) = 0;
    virtual void UnloadWaitWindow() = 0; ///< frmWait
    virtual void ShowMainWindow() = 0;
};

/// The way back after Cancel: the progress panel hides, the suggestions window unloads and the
/// wizard returns to its entry state with the main window shown.
void TakeWayBack(SuggestionsView &view, WizardHost &host);

/// Caption of lblWord when every token has been handed on.
inline constexpr QStringView kEnterAlternatesCaption = u"Please enter alternate words.";

/// Splits title and contents into `model`, then hands every token on; returns false when cancelled
/// (StopProcessing found set before a contents token or after the last one).
bool FillWordLists(const QString &title, const QString &contents, ArticleTokens &model,
                   SuggestionsView &view, WizardHost &host);

} // namespace verbloom
