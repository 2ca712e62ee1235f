#pragma once

#include "ThesaurusData.h"

#include <QByteArray>
#include <QList>
#include <QString>

namespace verbloom {

/// The thesaurus page of a word (UTF-8 HTML). Its rendered text is the heading line
/// "Thesaurus: WORD", then for every meaning exactly four lines: "Main Entry: " head term,
/// "Part of Speech: ", "Definition: " and "Synonyms: " with the terms joined by ", ".
/// Without meanings the heading is followed by "No entry was found." and nothing else.
/// Every line is its own block element, so a browser and HtmlInnerText render the same lines.
QByteArray ThesaurusPageHtml(const QString &word, const QList<ThesaurusMeaning> &meanings);

/// A small page for an error response: its title and one line of text.
QByteArray MessagePageHtml(const QString &title, const QString &message);

} // namespace verbloom
