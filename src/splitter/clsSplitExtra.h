#pragma once

#include <QList>
#include <QString>
#include <QStringList>
#include <QStringView>

namespace verbloom {

/// One registered delimiter. Offsets count from the match position.
struct DelimiterEntry
{
    QString Delimiter;
    int DelimKind = 0;
    qsizetype DelimLen = 0;
    qsizetype NextStartOffset = 0; ///< where the next token starts
    qsizetype PieceEndOffset = 0;  ///< where the text before the match ends
};

/// Token splitter: registered delimiters, each with a kind that says what becomes of the
/// delimiter text; splits strings, string arrays and text files into a token list that
/// accumulates until ClearTokens, with a sorted index and search members on top.
///
/// Errors are shown through the splitter's message sink (SplitterMessageSink.h); the member then
/// returns without effect.
class clsSplitExtra final
{
public:
    static constexpr int DELIM_EXCLUDE = 0; ///< dropped
    static constexpr int DELIM_TRAIL = 1;   ///< kept at the end of the preceding token
    static constexpr int DELIM_LEAD = 2;    ///< kept at the start of the following token
    static constexpr int DELIM_BOTH = 3;    ///< kept at both
    static constexpr int DELIM_TOKEN = 4;   ///< a token of its own

    /// File pieces of SplitFile, in bytes: a file larger than one piece needs every delimiter
    /// to be shorter than a piece.
    static constexpr qsizetype kFilePieceBytes = 64000;

    clsSplitExtra();

    /// Switches the design-mode form of the error box on or off (on at creation).
    void DesignMode(bool rBlON_OFF);
    /// Registers a delimiter, or changes the kind of one already registered (keeping its place).
    void AddDelimiter(const QString &Delimiter, int rCnDELIM);
    /// The token at the index; "" after an error when the index is out of range.
    QString Token(qsizetype rLgIndex) const;
    /// Number of tokens held.
    qsizetype TokenCount() const { return m_TokenList.size(); }
    /// Sets the compare method of the index and search members: 0 exact, 1 case-insensitive.
    /// Refused once tokens are held.
    void TokenCompareMethod(int rInCmpMthd);
    /// Splits the whole text of a file (UTF-8, else Windows-1252) and appends its tokens.
    void SplitFile(const QString &rStFile);
    /// Splits one text and appends its tokens.
    void SplitString(const QString &rStText);
    /// Splits the elements joined as one text and appends its tokens.
    void SplitArray(const QStringList &rStText);

    /// Builds the sorted index of the tokens.
    void TokenNdxCreate();
    /// Position of the first token equal to the value, or -1.
    qsizetype TokenFindFirst(const QString &vStToken);
    /// Position of the next token equal to the value of the last TokenFindFirst, or -1.
    qsizetype TokenFindNext();
    /// Number of places where the tokens match rStCompare(0..rLgCompareMaxArray).
    qsizetype TokenSequenceCount(const QStringList &rStCompare, qsizetype rLgCompareMaxArray);
    /// Start of the n-th place where the tokens match the sequence, or -1.
    qsizetype TokenFindNthSequence(qsizetype iLgNthOccurance, const QStringList &rStCompare,
                                   qsizetype rLgCompareMaxArray);
    /// Writes "Token Listing - Total Tokens: n" and the tokens in text order, CR LF after every
    /// line. Returns false (after the error box) when the file could not be written.
    bool SaveTokenArrayToFile(const QString &rStFile);
    /// Writes "Sorted Index - Total Tokens: n" and the tokens in sorted order.
    bool SaveSortedTokenArrayToFile(const QString &rStFile);
    /// Copies the tokens into rStToken; left as it was when no token is held.
    void TransferTokenArray(QStringList &rStToken);

    /// Empties the tokens and the index state.
    void ClearTokens();
    /// Empties the delimiters.
    void ClearDelimiters();

    // Read access to the state, for callers that need more than the members above.
    const QStringList &Tokens() const { return m_TokenList; }
    const QList<DelimiterEntry> &Delimiters() const { return m_DelimiterList; }
    qsizetype MaxDelimiterLen() const { return m_MaxDelimiterLen; }
    int CompareMethod() const { return m_CompareMethod; }
    bool IndexBuilt() const { return m_IndexBuilt; }
    const QList<qsizetype> &SortIndex() const { return m_SortIndex; }

private:
    /// Shows the error box; ends the program after a design-mode Yes.
    void ReportClassError(const QString &routine, const QString &message) const;
    /// The checks shared by the split members (pieces of an array or file); false after an error.
    bool CheckSplit(qsizetype pieceCount, qsizetype shortestLeadingPiece) const;
    void iSbTokenSplit(QStringView text);
    bool EnsureIndex();
    qsizetype LastPosition() const { return m_TokenList.size() - 1; }
    qsizetype MiddlePosition() const { return LastPosition() / 2; }
    bool WriteListing(const QString &routine, const QString &file, const QString &header,
                      const QList<qsizetype> *order);

    QList<DelimiterEntry> m_DelimiterList;
    qsizetype m_MaxDelimiterLen = -1;
    QStringList m_TokenList;
    int m_CompareMethod = 0;
    bool m_DesignMode = true;
    QList<qsizetype> m_SortIndex;
    bool m_IndexBuilt = false;
    QString m_FindToken;
    qsizetype m_FindPosition = -1;
};

} // namespace verbloom
