#include "ArticleModel.h"

#include "splitter/clsSplitExtra.h"

#include <algorithm>

namespace verbloom {

bool StopProcessing = true;

namespace {

constexpr char16_t AsciiUpper(char16_t c)
{
    return c >= u'a' && c <= u'z' ? char16_t(c - (u'a' - u'A')) : c;
}

bool IsAscii(QStringView text)
{
    return std::all_of(text.begin(), text.end(), [](QChar c) { return c.unicode() < 0x80; });
}

bool IsExcludedCharacter(char16_t c)
{
    switch (c) {
    case u'@': case u'#': case u'=': case u'%': case u'$': case u'^': case u'*': case u'&':
    case u'\u2026':
        return true;
    default:
        return false;
    }
}

// Whether `upper`, already upper-cased, equals the ASCII `word` upper-cased.
bool EqualsAsciiUpper(QStringView upper, QStringView word)
{
    if (upper.size() != word.size())
        return false;
    for (qsizetype i = 0; i < word.size(); ++i) {
        if (upper[i].unicode() != AsciiUpper(word[i].unicode()))
            return false;
    }
    return true;
}

// token.toUpper() == word.toUpper(), allocating only when non-ASCII text is involved.
// `tokenUpper` caches the token's upper case across the ignored words of one call.
bool SameUpperCase(const QString &token, bool tokenIsAscii, QString &tokenUpper,
                   const QString &word)
{
    const bool wordIsAscii = IsAscii(word);
    if (tokenIsAscii && wordIsAscii) {
        if (token.size() != word.size())
            return false;
        for (qsizetype i = 0; i < word.size(); ++i) {
            if (AsciiUpper(token[i].unicode()) != AsciiUpper(word[i].unicode()))
                return false;
        }
        return true;
    }
    if (tokenUpper.isNull())
        tokenUpper = token.toUpper();
    if (wordIsAscii) // a non-ASCII token may still upper-case to ASCII ("ſ" gives "S")
        return EqualsAsciiUpper(tokenUpper, word);
    return tokenUpper == word.toUpper();
}

} // namespace

bool IsCustomizableWord(const QString &token, const WordTestSettings &settings)
{
    if (token.size() <= settings.MinimumWordLength)
        return false;
    // One scan decides the numeric, digit and character tests: a number always holds a digit,
    // and the tests only combine into one result.
    bool isAscii = true;
    for (const QChar c : token) {
        const char16_t u = c.unicode();
        if ((u >= u'0' && u <= u'9') || IsExcludedCharacter(u))
            return false;
        isAscii = isAscii && u < 0x80;
    }
    QString tokenUpper;
    return std::none_of(settings.IgnoredWords.begin(), settings.IgnoredWords.end(),
                        [&](const QString &word) {
                            return SameUpperCase(token, isAscii, tokenUpper, word);
                        });
}

const QStringList &ArticleDelimiters()
{
    static const QStringList delimiters = {
        u"*"_qs, u","_qs, u"."_qs, u" "_qs, u"\n"_qs, u":"_qs, u";"_qs,
        u"/"_qs, u"!"_qs, u"?"_qs, u"'"_qs, u"\""_qs, u"("_qs, u")"_qs,
        u"["_qs, u"]"_qs, u"{"_qs, u"}"_qs, u"+"_qs, u"-"_qs, u"_"_qs,
        u"<"_qs, u">"_qs, u"\u201C"_qs, u"\u201D"_qs, u"\u2018"_qs, u"\u2019"_qs, u"|"_qs};
    return delimiters;
}

ArticleTokens SplitArticle(const QString &title, const QString &contents)
{
    clsSplitExtra splitter;
    splitter.DesignMode(true);
    for (const QString &delimiter : ArticleDelimiters())
        splitter.AddDelimiter(delimiter, clsSplitExtra::DELIM_TOKEN);

    ArticleTokens result;
    // The token list is shared, not copied token by token.
    splitter.SplitString(title);
    result.TitleTokens = splitter.Tokens();
    splitter.ClearTokens();

    QString text = contents;
    text.replace(u"\r\n"_qs, u"\n"_qs);
    text.replace(QLatin1Char('\r'), QLatin1Char('\n'));
    splitter.SplitString(text);
    result.ContentsTokens = splitter.Tokens();
    return result;
}

ArticleTokens &CurrentArticle()
{
    static ArticleTokens article;
    return article;
}

void TakeWayBack(SuggestionsView &view, WizardHost &host)
{
    view.SetStatusVisible(false);
    view.Unload();
    host.cmdNext_Click();
    host.SetButton(false);
    host.UnloadWaitWindow();
    host.ShowMainWindow();
}

bool FillWordLists(const QString &title, const QString &contents, ArticleTokens &model,
                   SuggestionsView &view, WizardHost &host)
{
    view.ShowModeless();
    view.ClearLists();
    view.SetStatusVisible(true);

    model = SplitArticle(title, contents);
    // The loops walk their own copies: handlers that run while AddItems waits may analyse again.
    const QStringList titleTokens = model.TitleTokens;
    const QStringList contentsTokens = model.ContentsTokens;

    const qsizetype n = titleTokens.size() - 1;
    if (n > 0)
        view.SetProgressMaximum(n);
    for (qsizetype i = 0; i <= n; ++i) {
        view.ShowModeless();
        view.SetProgressValue(i);
        view.SetWordCaption(titleTokens.at(i));
        view.AddItems(titleTokens.at(i), 0);
    }

    const qsizetype m = contentsTokens.size() - 1;
    view.SetProgressMaximum(std::max<qsizetype>(m, 0));
    for (qsizetype i = 0; i <= m; ++i) {
        if (StopProcessing) {
            TakeWayBack(view, host);
            return false;
        }
        view.SelectContentsTab();
        view.ShowModeless();
        view.SetProgressValue(i);
        view.SetWordCaption(contentsTokens.at(i));
        view.AddItems(contentsTokens.at(i), 1);
    }
    // A Cancel during the last token has hidden the main window too: take the way back.
    if (StopProcessing) {
        TakeWayBack(view, host);
        return false;
    }

    view.SetWordCaption(kEnterAlternatesCaption.toString());
    view.SetStatusVisible(false);
    return true;
}

} // namespace verbloom
