#include "ArticleChecks.h"

#include <algorithm>

namespace verbloom {

namespace {

bool IsBlank(const QString &text)
{
    return std::all_of(text.begin(), text.end(), [](QChar c) { return c == QLatin1Char(' '); });
}

} // namespace

std::optional<ArticleRefusal> VerifyArticleTexts(const QString &title, const QString &contents)
{
    if (IsBlank(title))
        return ArticleRefusal{ArticleField::Title, u"The title cannot be blank."_qs};
    if (IsBlank(contents))
        return ArticleRefusal{ArticleField::Contents, u"The contents cannot be blank."_qs};
    return std::nullopt;
}

QString WithClosingBlank(const QString &text)
{
    return text.endsWith(QLatin1Char(' ')) ? text : text + QLatin1Char(' ');
}

std::optional<QString> CheckIgnoredWord(const QString &word, int minimumWordLength)
{
    if (word.isEmpty())
        return u"Please make sure that the ignore word is not empty"_qs;
    if (word.size() <= minimumWordLength) {
        return u"Please make sure that the number of letters in ignore word is more than "_qs
            + QString::number(minimumWordLength);
    }
    // The last of these, in this order, that occurs is the one named.
    std::optional<QChar> found;
    for (const QChar c : {QLatin1Char(' '), QLatin1Char('.'), QLatin1Char(','), QLatin1Char('\'')}) {
        if (word.contains(c))
            found = c;
    }
    if (found)
        return u"Please make sure that the letter \""_qs + *found + u"\" is NOT there in your word"_qs;
    return std::nullopt;
}

} // namespace verbloom
