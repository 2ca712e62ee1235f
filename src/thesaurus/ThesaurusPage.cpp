#include "ThesaurusPage.h"

namespace verbloom {

namespace {

QString Line(const QString &text)
{
    return u"<div>"_qs + text.toHtmlEscaped() + u"</div>\n"_qs;
}

QByteArray Document(const QString &title, const QString &body)
{
    const QString html = u"<!DOCTYPE html>\n<html lang=\"en\">\n<head>\n<meta charset=\"utf-8\">\n"
                         "<title>"_qs
        + title.toHtmlEscaped()
        + u"</title>\n<style>body{font-family:sans-serif;margin:1em 2em}"
          "h1{font-size:1.4em}.meaning{margin:1em 0}</style>\n</head>\n<body>\n"_qs
        + body + u"</body>\n</html>\n"_qs;
    return html.toUtf8();
}

} // namespace

QByteArray ThesaurusPageHtml(const QString &word, const QList<ThesaurusMeaning> &meanings)
{
    QString body = u"<h1>"_qs + QString(u"Thesaurus: "_qs + word).toHtmlEscaped() + u"</h1>\n"_qs;
    if (meanings.isEmpty())
        body += Line(u"No entry was found."_qs);
    for (const ThesaurusMeaning &meaning : meanings) {
        body += u"<div class=\"meaning\">\n"_qs;
        body += Line(u"Main Entry: "_qs + meaning.HeadTerm);
        body += Line(u"Part of Speech: "_qs + meaning.PartOfSpeech);
        body += Line(u"Definition: "_qs + meaning.HeadTerm + u" ("_qs + meaning.PartOfSpeech
                     + u")"_qs);
        body += Line(u"Synonyms: "_qs + meaning.Synonyms.join(u", "_qs));
        body += u"</div>\n"_qs;
    }
    return Document(word + u" - Thesaurus"_qs, body);
}

QByteArray MessagePageHtml(const QString &title, const QString &message)
{
    return Document(title, u"<h1>"_qs + title.toHtmlEscaped() + u"</h1>\n"_qs + Line(message));
}

} // namespace verbloom
