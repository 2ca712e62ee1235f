#include "clsSplitExtra.h"

#include "SplitterMessageSink.h"
#include "basStringArrayNdx.h"
#include "common/TextFile.h"

#include <QFile>

#include <algorithm>
#include <vector>

namespace verbloom {

namespace {

const QString kCrLf = QStringLiteral("\r\n");

// The next match of one delimiter; the heap yields the smallest position, and at equal
// positions the delimiter registered first.
struct PendingMatch
{
    qsizetype Position;
    qsizetype Order;
};

struct LaterMatch
{
    bool operator()(const PendingMatch &a, const PendingMatch &b) const
    {
        return a.Position != b.Position ? a.Position > b.Position : a.Order > b.Order;
    }
};

qsizetype FindDelimiter(QStringView text, const DelimiterEntry &entry, qsizetype from)
{
    if (entry.DelimLen != 1)
        return text.indexOf(entry.Delimiter, from);
    // Frequent delimiters (the blank) recur within a few characters: look there first.
    const QChar c = entry.Delimiter.front();
    const qsizetype nearEnd = std::min(text.size(), from + 16);
    for (qsizetype i = from; i < nearEnd; ++i) {
        if (text[i] == c)
            return i;
    }
    return nearEnd < text.size() ? text.indexOf(c, nearEnd) : -1;
}

} // namespace

clsSplitExtra::clsSplitExtra()
{
    ClearTokens();
    ClearDelimiters();
}

void clsSplitExtra::DesignMode(bool rBlON_OFF)
{
    m_DesignMode = rBlON_OFF;
}

void clsSplitExtra::ReportClassError(const QString &routine, const QString &message) const
{
    QString prompt = u"Accessing Routine: '"_qs + routine + u"'"_qs + kCrLf + message + kCrLf;
    if (m_DesignMode)
        prompt += kCrLf + u"Break to Examine Call Stack?"_qs;
    SplitterMessageSink &sink = CurrentSplitterMessageSink();
    if (sink.ShowSplitterMessage(prompt, m_DesignMode) == SplitterAnswer::Yes && m_DesignMode)
        sink.EndProgram();
}

void clsSplitExtra::AddDelimiter(const QString &Delimiter, int rCnDELIM)
{
    const QString routine = u"AddDelimiter"_qs;
    if (Delimiter.isEmpty()) {
        ReportClassError(routine, u"Delimiter length cannot be 0."_qs);
        return;
    }
    if (rCnDELIM < DELIM_EXCLUDE || rCnDELIM > DELIM_TOKEN) {
        ReportClassError(routine, u"DELIM_ Constant not recognized."_qs);
        return;
    }
    auto it = std::find_if(m_DelimiterList.begin(), m_DelimiterList.end(),
                           [&](const DelimiterEntry &e) { return e.Delimiter == Delimiter; });
    if (it == m_DelimiterList.end())
        it = m_DelimiterList.insert(m_DelimiterList.end(), DelimiterEntry());
    DelimiterEntry &entry = *it;
    entry.Delimiter = Delimiter;
    entry.DelimKind = rCnDELIM;
    entry.DelimLen = Delimiter.size();
    const bool keepsTrail = rCnDELIM == DELIM_TRAIL || rCnDELIM == DELIM_BOTH;
    const bool keepsLead = rCnDELIM == DELIM_LEAD || rCnDELIM == DELIM_BOTH;
    entry.PieceEndOffset = keepsTrail ? entry.DelimLen - 1 : -1;
    entry.NextStartOffset = keepsLead ? 0 : entry.DelimLen;
    m_MaxDelimiterLen = std::max(m_MaxDelimiterLen, entry.DelimLen);
}

QString clsSplitExtra::Token(qsizetype rLgIndex) const
{
    if (rLgIndex < 0 || rLgIndex >= m_TokenList.size()) {
        ReportClassError(u"Token"_qs, u"Index Out Of Range: "_qs + QString::number(rLgIndex));
        return QString();
    }
    return m_TokenList.at(rLgIndex);
}

void clsSplitExtra::TokenCompareMethod(int rInCmpMthd)
{
    const QString routine = u"TokenCompareMethod"_qs;
    if (rInCmpMthd != 0 && rInCmpMthd != 1) {
        ReportClassError(routine, u"Invalid CompareMethod: "_qs + QString::number(rInCmpMthd));
        return;
    }
    if (!m_TokenList.isEmpty()) {
        ReportClassError(routine, u"Document 'CompareMethod' Must Be Set "_qs
                                      + u"Proir to Split"_qs);
        return;
    }
    m_CompareMethod = rInCmpMthd;
}

bool clsSplitExtra::CheckSplit(qsizetype pieceCount, qsizetype shortestLeadingPiece) const
{
    const QString routine = u"iSbTokenSplit"_qs;
    if (m_DelimiterList.isEmpty()) {
        ReportClassError(routine, u"No current delimiters."_qs);
        return false;
    }
    // A match may span two pieces only when every piece but the last is longer than any
    // delimiter.
    if (pieceCount >= 2 && shortestLeadingPiece <= m_MaxDelimiterLen) {
        ReportClassError(routine, u"Delimiter is larger than array."_qs);
        return false;
    }
    return true;
}

void clsSplitExtra::SplitString(const QString &rStText)
{
    if (CheckSplit(1, 0))
        iSbTokenSplit(rStText);
}

void clsSplitExtra::SplitArray(const QStringList &rStText)
{
    qsizetype shortest = 0;
    if (rStText.size() >= 2) {
        shortest = std::min_element(rStText.begin(), rStText.end() - 1,
                                    [](const QString &a, const QString &b) {
                                        return a.size() < b.size();
                                    })->size();
    }
    if (CheckSplit(rStText.size(), shortest))
        iSbTokenSplit(rStText.join(QString()));
}

void clsSplitExtra::SplitFile(const QString &rStFile)
{
    QFile file(rStFile);
    QByteArray bytes;
    bool read = !rStFile.isEmpty() && file.open(QIODevice::ReadOnly);
    if (read) {
        bytes = file.readAll();
        read = file.error() == QFileDevice::NoError;
        file.close();
    }
    if (!read) {
        ReportClassError(u"ReadFileChunks"_qs, u"Unable to read file: "_qs + rStFile);
        return;
    }
    // The whole file is decoded before splitting, so no character is cut at a piece boundary;
    // the piece rule of the size check still applies.
    const qsizetype pieces = (bytes.size() + kFilePieceBytes - 1) / kFilePieceBytes;
    if (CheckSplit(pieces, kFilePieceBytes))
        iSbTokenSplit(DecodeText(bytes));
}

void clsSplitExtra::iSbTokenSplit(QStringView text)
{
    m_IndexBuilt = false;
    const qsizetype length = text.size();

    std::vector<PendingMatch> heap;
    heap.reserve(m_DelimiterList.size());
    for (qsizetype j = 0; j < m_DelimiterList.size(); ++j) {
        const qsizetype p = FindDelimiter(text, m_DelimiterList.at(j), 0);
        if (p >= 0)
            heap.push_back({p, j});
    }
    std::make_heap(heap.begin(), heap.end(), LaterMatch());

    qsizetype start = 0;
    const DelimiterEntry *pending = nullptr;
    while (!heap.empty()) {
        std::pop_heap(heap.begin(), heap.end(), LaterMatch());
        PendingMatch &match = heap.back();
        const DelimiterEntry &d = m_DelimiterList.at(match.Order);
        const qsizetype p = match.Position;

        if (pending && pending->DelimKind == DELIM_TOKEN)
            m_TokenList.append(pending->Delimiter);
        const qsizetype pieceEnd = p + d.PieceEndOffset;
        if (start <= pieceEnd) {
            const QStringView piece = text.sliced(start, pieceEnd - start + 1);
            if (piece != d.Delimiter)
                m_TokenList.append(piece.toString());
        }
        start = p + d.NextStartOffset;
        pending = &d;
        if (p + d.DelimLen == length)
            break;
        // Only this delimiter is searched again; matches of others that overlap it stay queued.
        match.Position = FindDelimiter(text, d, p + d.DelimLen);
        if (match.Position >= 0)
            std::push_heap(heap.begin(), heap.end(), LaterMatch());
        else
            heap.pop_back();
    }
    if (pending && pending->DelimKind == DELIM_TOKEN)
        m_TokenList.append(pending->Delimiter);
    if (start < length)
        m_TokenList.append(text.sliced(start).toString());
}

bool clsSplitExtra::EnsureIndex()
{
    if (!m_IndexBuilt)
        TokenNdxCreate();
    return m_IndexBuilt;
}

void clsSplitExtra::TokenNdxCreate()
{
    if (m_TokenList.isEmpty()) {
        ReportClassError(u"TokenNdxCreate"_qs, u"No tokens to index."_qs);
        return;
    }
    BuildSortIndex(m_TokenList, m_SortIndex, m_CompareMethod);
    m_IndexBuilt = true;
}

qsizetype clsSplitExtra::TokenFindFirst(const QString &vStToken)
{
    m_FindToken = vStToken;
    if (!EnsureIndex())
        return -1;
    return FindFirstInIndex(m_TokenList, m_SortIndex, 0, MiddlePosition(), LastPosition(),
                            m_FindToken, m_FindPosition, m_CompareMethod);
}

qsizetype clsSplitExtra::TokenFindNext()
{
    if (!EnsureIndex())
        return -1;
    return FindNextInIndex(m_TokenList, m_SortIndex, LastPosition(), m_FindToken,
                           m_FindPosition, m_CompareMethod);
}

qsizetype clsSplitExtra::TokenSequenceCount(const QStringList &rStCompare,
                                            qsizetype rLgCompareMaxArray)
{
    if (!EnsureIndex())
        return 0;
    return FindSequence(m_TokenList, m_SortIndex, 0, MiddlePosition(), LastPosition(),
                        m_FindPosition, m_CompareMethod, 0, rStCompare, rLgCompareMaxArray)
        .Count;
}

qsizetype clsSplitExtra::TokenFindNthSequence(qsizetype iLgNthOccurance,
                                              const QStringList &rStCompare,
                                              qsizetype rLgCompareMaxArray)
{
    if (!EnsureIndex() || iLgNthOccurance < 1)
        return -1;
    return FindSequence(m_TokenList, m_SortIndex, 0, MiddlePosition(), LastPosition(),
                        m_FindPosition, m_CompareMethod, iLgNthOccurance, rStCompare,
                        rLgCompareMaxArray)
        .Position;
}

bool clsSplitExtra::WriteListing(const QString &routine, const QString &file,
                                 const QString &header, const QList<qsizetype> *order)
{
    QString text = header + QString::number(m_TokenList.size()) + kCrLf;
    for (qsizetype k = 0; k < m_TokenList.size(); ++k)
        text += m_TokenList.at(order ? order->at(k) : k) + kCrLf;
    if (WriteTextFile(file, text))
        return true;
    ReportClassError(routine, u"Unable to write file: "_qs + file);
    return false;
}

bool clsSplitExtra::SaveTokenArrayToFile(const QString &rStFile)
{
    return WriteListing(u"SaveTokenArrayToFile"_qs, rStFile,
                        u"Token Listing - Total Tokens: "_qs, nullptr);
}

bool clsSplitExtra::SaveSortedTokenArrayToFile(const QString &rStFile)
{
    // Without tokens the index reports "No tokens to index." and the listing holds only its
    // first line.
    EnsureIndex();
    return WriteListing(u"SaveSortedTokenArrayToFile"_qs, rStFile,
                        u"Sorted Index - Total Tokens: "_qs, &m_SortIndex);
}

void clsSplitExtra::TransferTokenArray(QStringList &rStToken)
{
    if (m_TokenList.isEmpty()) {
        ReportClassError(u"TransferTokenArray"_qs, u"No tokens available for transfer."_qs);
        return;
    }
    rStToken = m_TokenList;
}

void clsSplitExtra::ClearTokens()
{
    m_TokenList = QStringList();
    m_SortIndex = QList<qsizetype>();
    m_IndexBuilt = false;
    m_FindPosition = -1;
}

void clsSplitExtra::ClearDelimiters()
{
    m_DelimiterList = QList<DelimiterEntry>();
    m_MaxDelimiterLen = -1;
}

} // namespace verbloom
