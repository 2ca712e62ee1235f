#pragma once

#include <QByteArray>
#include <QString>

namespace verbloom {

/// Renders an HTML document to the text a browser gives as the inner text of the root element,
/// for ordinary pages without style sheets: block elements end a line (a paragraph leaves an
/// empty line before and after), <br> breaks the line, table cells are separated by a tab, runs
/// of blanks collapse to one and vanish at line ends, <pre> keeps its blanks; tags are dropped,
/// entities decoded, and what a browser does not show (head, script, style, template, noscript,
/// form lists, elements marked hidden or "display:none") is skipped. Lines are joined with CR LF.
/// `charset` is the one the server named, if any (see DecodePage).
QString HtmlInnerText(const QByteArray &html, const QByteArray &charset = QByteArray());

/// Decodes a page as browsers do: by the charset the server named (Latin-1 and ASCII labels
/// mean Windows-1252), else, for HTML, by a byte-order mark or <meta> declaration, else as
/// UTF-8 when the bytes are valid UTF-8, else as Windows-1252.
QString DecodePage(const QByteArray &bytes, const QByteArray &charset, bool html);

} // namespace verbloom
