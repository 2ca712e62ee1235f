#pragma once

#include <QString>

#include <optional>

namespace verbloom {

/// Which article box a refusal of "Next" points at.
enum class ArticleField { Title, Contents };

struct ArticleRefusal
{
    ArticleField Field;
    QString Message;
};

/// The check of "Next": "The title cannot be blank." or "The contents cannot be blank."
/// (only the blank, code 32, counts as blank), or nothing when both texts may be analysed.
std::optional<ArticleRefusal> VerifyArticleTexts(const QString &title, const QString &contents);

/// The text with one blank appended when it does not end with one, as "Next" leaves the boxes.
QString WithClosingBlank(const QString &text);

/// The refusal of "Add to list" for an ignored word, or nothing when it may be added.
std::optional<QString> CheckIgnoredWord(const QString &word, int minimumWordLength);

} // namespace verbloom
