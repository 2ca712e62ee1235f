#include "HtmlInnerText.h"

#include "common/TextFile.h"

#include <QByteArrayView>
#include <QStringDecoder>

#include <libxml/HTMLparser.h>
#include <libxml/tree.h>

#include <algorithm>
#include <climits>
#include <mutex>
#include <optional>
#include <vector>

namespace verbloom {

namespace {

bool IsNamed(const xmlNode *node, std::initializer_list<const char *> names)
{
    const QByteArrayView name(reinterpret_cast<const char *>(node->name));
    return std::any_of(names.begin(), names.end(),
                       [&](const char *candidate) { return name == candidate; });
}

bool IsBlock(const xmlNode *node)
{
    return IsNamed(node, {"address", "article", "aside", "blockquote", "body", "caption", "center",
                          "dd", "details", "dialog", "dir", "div", "dl", "dt", "fieldset",
                          "figcaption", "figure", "footer", "form", "frameset", "h1", "h2", "h3",
                          "h4", "h5", "h6", "header", "hgroup", "hr", "html", "legend", "li",
                          "listing", "main", "menu", "nav", "ol", "optgroup", "option", "plaintext",
                          "pre", "search", "section", "summary", "table", "ul", "xmp"});
}

bool KeepsBlanks(const xmlNode *node)
{
    return IsNamed(node, {"pre", "listing", "plaintext", "xmp"});
}

QByteArray Attribute(const xmlNode *node, const char *name)
{
    xmlChar *value = xmlGetProp(node, reinterpret_cast<const xmlChar *>(name));
    if (!value)
        return {};
    QByteArray result(reinterpret_cast<const char *>(value));
    xmlFree(value);
    return result;
}

/// Elements a browser does not render by default, or that are hidden by their attributes.
bool IsHidden(const xmlNode *node)
{
    if (IsNamed(node, {"head", "title", "script", "style", "template", "noscript", "noembed",
                       "noframes", "meta", "link", "base", "iframe", "object", "embed", "audio",
                       "video", "canvas", "datalist", "textarea", "input", "param",
                       "source", "track", "area", "rp"}))
        return true;
    if (xmlHasProp(node, reinterpret_cast<const xmlChar *>("hidden")))
        return true;
    if (IsNamed(node, {"dialog"}) && !xmlHasProp(node, reinterpret_cast<const xmlChar *>("open")))
        return true;
    QByteArray style = Attribute(node, "style").toLower();
    style.replace(' ', "").replace('\t', "").replace('\n', "").replace('\r', "");
    return style.contains("display:none");
}

/// A closed <details> shows its <summary> only.
bool IsFolded(const xmlNode *node)
{
    const xmlNode *parent = node->parent;
    return parent && parent->type == XML_ELEMENT_NODE && IsNamed(parent, {"details"})
        && !xmlHasProp(parent, reinterpret_cast<const xmlChar *>("open"))
        && !(node->type == XML_ELEMENT_NODE && IsNamed(node, {"summary"}));
}

/// A paragraph directly in <html> is one the parser implied around loose text: no breaks.
bool IsParagraph(const xmlNode *node)
{
    return IsNamed(node, {"p"}) && !(node->parent && node->parent->type == XML_ELEMENT_NODE
                                     && IsNamed(node->parent, {"html"}));
}

bool IsCell(const xmlNode *node)
{
    return node->type == XML_ELEMENT_NODE && IsNamed(node, {"td", "th"});
}

bool IsRow(const xmlNode *node)
{
    return node->type == XML_ELEMENT_NODE && IsNamed(node, {"tr"});
}

bool HasLaterCell(const xmlNode *cell)
{
    for (const xmlNode *next = cell->next; next; next = next->next) {
        if (IsCell(next) && !IsHidden(next))
            return true;
    }
    return false;
}

/// Whether another row of the same table follows, in this row group or a later one.
bool HasLaterRow(const xmlNode *row)
{
    for (const xmlNode *next = row->next; next; next = next->next) {
        if (IsRow(next) && !IsHidden(next))
            return true;
    }
    const xmlNode *group = row->parent;
    if (!group || !IsNamed(group, {"tbody", "thead", "tfoot"}))
        return false;
    for (const xmlNode *next = group->next; next; next = next->next) {
        if (next->type != XML_ELEMENT_NODE || IsHidden(next)
            || !IsNamed(next, {"tbody", "thead", "tfoot", "tr"}))
            continue;
        if (IsRow(next))
            return true;
        for (const xmlNode *child = next->children; child; child = child->next) {
            if (IsRow(child) && !IsHidden(child))
                return true;
        }
    }
    return false;
}

/// Collects the rendered text: collapsible blanks, forced line breaks and the "required line
/// breaks" around blocks, which merge with their neighbours and vanish at both ends.
class TextCollector final
{
public:
    void Text(QStringView text, bool keepBlanks)
    {
        for (qsizetype i = 0; i < text.size(); ++i) {
            const QChar c = text[i];
            if (keepBlanks && m_dropLeadingNewline) {
                m_dropLeadingNewline = false;
                if (c == QLatin1Char('\n'))
                    continue;
            }
            if (!keepBlanks && IsCollapsible(c)) {
                m_pendingSpace = true;
                continue;
            }
            StartContent();
            if (c == QLatin1Char('\r') || c == QLatin1Char('\n')) {
                if (c == QLatin1Char('\r') && i + 1 < text.size() && text[i + 1] == QLatin1Char('\n'))
                    ++i;
                m_text += QLatin1Char('\n');
                m_lineStart = true;
            } else {
                m_text += c;
                m_lineStart = false;
            }
        }
    }

    void LineBreak()
    {
        FlushBreaks();
        m_pendingSpace = false;
        m_text += QLatin1Char('\n');
        m_lineStart = true;
    }

    void CellSeparator()
    {
        FlushBreaks();
        m_pendingSpace = false;
        m_text += QLatin1Char('\t');
        m_lineStart = true;
    }

    void RequiredBreaks(int count)
    {
        m_pendingSpace = false;
        m_pendingBreaks = std::max(m_pendingBreaks, count);
    }

    void StartPreformatted() { m_dropLeadingNewline = true; }
    void EndPreformatted() { m_dropLeadingNewline = false; }

    QString Result() const
    {
        QString text = m_text;
        return text.replace(QLatin1Char('\n'), u"\r\n"_qs);
    }

private:
    static bool IsCollapsible(QChar c)
    {
        return c == QLatin1Char(' ') || c == QLatin1Char('\t') || c == QLatin1Char('\n')
            || c == QLatin1Char('\r') || c == QLatin1Char('\f');
    }

    void FlushBreaks()
    {
        if (m_pendingBreaks > 0 && !m_text.isEmpty()) {
            m_text += QString(m_pendingBreaks, QLatin1Char('\n'));
            m_lineStart = true;
        }
        m_pendingBreaks = 0;
    }

    void StartContent()
    {
        FlushBreaks();
        if (m_pendingSpace && !m_lineStart)
            m_text += QLatin1Char(' ');
        m_pendingSpace = false;
    }

    QString m_text;
    int m_pendingBreaks = 0;
    bool m_pendingSpace = false;
    bool m_lineStart = true;
    bool m_dropLeadingNewline = false;
};

void Enter(const xmlNode *node, TextCollector &out, int &keepBlanks)
{
    if (IsParagraph(node))
        out.RequiredBreaks(2);
    else if (IsBlock(node))
        out.RequiredBreaks(1);
    if (IsNamed(node, {"br"}))
        out.LineBreak();
    if (KeepsBlanks(node)) {
        ++keepBlanks;
        out.StartPreformatted();
    }
}

void Leave(const xmlNode *node, TextCollector &out, int &keepBlanks)
{
    if (KeepsBlanks(node)) {
        --keepBlanks;
        out.EndPreformatted();
    }
    if (IsCell(node) && HasLaterCell(node))
        out.CellSeparator();
    else if (IsRow(node) && HasLaterRow(node))
        out.LineBreak();
    if (IsParagraph(node))
        out.RequiredBreaks(2);
    else if (IsBlock(node))
        out.RequiredBreaks(1);
}

/// Walks the tree without recursion, so deeply nested pages cannot exhaust the stack.
QString Render(xmlDoc *document)
{
    TextCollector out;
    int keepBlanks = 0;
    struct Step { xmlNode *Node; bool Leaving; };
    std::vector<Step> steps;
    const auto pushChildren = [&steps](xmlNode *parent) {
        xmlNode *last = parent->children;
        while (last && last->next)
            last = last->next;
        for (xmlNode *child = last; child; child = child->prev)
            steps.push_back({child, false});
    };
    pushChildren(reinterpret_cast<xmlNode *>(document));
    while (!steps.empty()) {
        const Step step = steps.back();
        steps.pop_back();
        xmlNode *node = step.Node;
        if (step.Leaving) {
            Leave(node, out, keepBlanks);
            continue;
        }
        if (IsFolded(node))
            continue;
        if (node->type == XML_TEXT_NODE || node->type == XML_CDATA_SECTION_NODE) {
            if (node->content)
                out.Text(QString::fromUtf8(reinterpret_cast<const char *>(node->content)),
                         keepBlanks > 0);
        } else if (node->type == XML_ELEMENT_NODE && !IsHidden(node)) {
            Enter(node, out, keepBlanks);
            steps.push_back({node, true});
            pushChildren(node);
        }
    }
    return out.Result();
}

std::optional<QString> DecodeByLabel(const QByteArray &bytes, const QByteArray &label)
{
    QByteArray name = label.trimmed().toLower();
    if (name.isEmpty())
        return std::nullopt;
    // Browsers read these labels as Windows-1252.
    if (name == "iso-8859-1" || name == "iso8859-1" || name == "latin1" || name == "l1"
        || name == "us-ascii" || name == "ascii")
        name = "windows-1252";
    QStringDecoder decoder(name.constData());
    if (!decoder.isValid())
        return std::nullopt;
    return decoder(bytes);
}

/// The parser puts text that comes before any element into an implied paragraph, which a
/// browser does not; an explicit <body> in front of such text keeps it plain.
QByteArray OpenBodyBeforeLeadingText(const QByteArray &utf8)
{
    qsizetype i = 0;
    while (i < utf8.size()) {
        const char c = utf8[i];
        if (c == ' ' || c == '\t' || c == '\n' || c == '\r' || c == '\f') {
            ++i;
        } else if (utf8.mid(i, 4) == "<!--") {
            const qsizetype end = utf8.indexOf("-->", i + 4);
            i = end < 0 ? utf8.size() : end + 3;
        } else if (utf8.mid(i, 2) == "<!" || utf8.mid(i, 2) == "<?") {
            const qsizetype end = utf8.indexOf('>', i);
            i = end < 0 ? utf8.size() : end + 1;
        } else {
            break;
        }
    }
    if (i >= utf8.size() || utf8[i] == '<')
        return utf8;
    return utf8.left(i) + "<body>" + utf8.mid(i);
}

} // namespace

QString DecodePage(const QByteArray &bytes, const QByteArray &charset, bool html)
{
    if (std::optional<QString> text = DecodeByLabel(bytes, charset))
        return *text;
    if (html) {
        const QStringDecoder declared = QStringDecoder::decoderForHtml(bytes);
        const QByteArray name = declared.isValid() ? QByteArray(declared.name()) : QByteArray();
        if (name.toLower() != "utf-8") {
            if (std::optional<QString> text = DecodeByLabel(bytes, name))
                return *text;
        }
    }
    return DecodeText(bytes);
}

QString HtmlInnerText(const QByteArray &html, const QByteArray &charset)
{
    static std::once_flag initialized;
    std::call_once(initialized, [] { xmlInitParser(); });

    QString text = DecodePage(html, charset, true);
    text.replace(QChar(0), QChar(QChar::ReplacementCharacter));
    const QByteArray utf8 = OpenBodyBeforeLeadingText(text.toUtf8());
    if (utf8.isEmpty() || utf8.size() > INT_MAX)
        return {};
    // No depth limit (XML_PARSE_HUGE): a deeply nested page would otherwise lose its rest.
    const int options = HTML_PARSE_RECOVER | HTML_PARSE_NOERROR | HTML_PARSE_NOWARNING
        | HTML_PARSE_NONET | HTML_PARSE_IGNORE_ENC | XML_PARSE_HUGE;
    xmlDoc *document = htmlReadMemory(utf8.constData(), int(utf8.size()), nullptr, "UTF-8", options);
    if (!document)
        return {};
    const QString rendered = Render(document);
    xmlFreeDoc(document);
    return rendered;
}

} // namespace verbloom
