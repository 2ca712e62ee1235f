#include "SpinGenerator.h"

#include "common/LineEnds.h"
#include "common/Numbers.h"
#include "engine/AlternativesList.h"
#include "engine/WordStore.h"

#include <algorithm>
#include <cmath>
#include <cstring>

namespace verbloom {

namespace {

// The replacement divisor m = level + 1. No selection (a negative index) counts as "Maximum"
// rather than dividing by zero.
int Divisor(const SpinSettings &settings)
{
    return std::clamp(settings.CustomizationLevel, 0, 32766) + 1;
}

// Length in UTF-16 units of the first character (a surrogate pair counts as one character).
qsizetype FirstCharLength(const QString &text)
{
    if (text.size() >= 2 && text.at(0).isHighSurrogate() && text.at(1).isLowSurrogate())
        return 2;
    return std::min<qsizetype>(text.size(), 1);
}

bool StartsWithCapital(const QString &token)
{
    const QString first = token.left(FirstCharLength(token));
    return first.toLower() != first;
}

// A candidate as it goes into the text: trimmed, the token when empty, and with a capital first
// letter when the token has one.
QString Choice(const QString &token, QStringView candidate)
{
    QString choice = TrimSpaces(candidate);
    if (choice.isEmpty())
        choice = token;
    if (StartsWithCapital(token)) {
        const qsizetype length = FirstCharLength(choice);
        choice = choice.left(length).toUpper() + choice.mid(length);
    }
    return choice;
}

// Products of a draw below this are rounded inline; every double below 2^52 fits an integer.
constexpr double kInlineRoundLimit = 4503599627370496.0;

// RoundHalfEven of a value in [0, 2^52), without branches: draws round up or down at random,
// so a branch would be mispredicted half the time.
qint64 RoundInRange(double value)
{
    const auto whole = static_cast<qint64>(value);
    const double fraction = value - static_cast<double>(whole);
    return whole + ((fraction > 0.5) | ((fraction == 0.5) & (whole & 1)));
}

// First draw: whether the level lets the word be replaced (r = round(u * 100) divisible by m).
template<typename Random>
bool LevelAllows(int divisor, Random &random)
{
    const double product = random.NextUniform() * 100.0;
    if (!(product >= 0.0 && product < kInlineRoundLimit))
        return std::fmod(RoundHalfEven(product), divisor) == 0.0;
    const qint64 r = RoundInRange(product);
    return divisor == 1 || r % divisor == 0;
}

// Second draw: the candidate k = round(u * n) of 0..n (n is the token itself), at most n.
template<typename Random>
qsizetype DrawCandidate(qsizetype n, Random &random)
{
    const double product = random.NextUniform() * static_cast<double>(n);
    if (!(product >= 0.0 && product < kInlineRoundLimit)) {
        const double k = RoundHalfEven(product);
        if (!(k > 0.0))
            return 0;
        return k >= static_cast<double>(n) ? n : static_cast<qsizetype>(k);
    }
    return std::min<qsizetype>(RoundInRange(product), n);
}

// The replacement of a customizable token.
QString ReplaceCustomizable(const QString &token, const QString &alternatives, int divisor,
                            RandomSource &random)
{
    if (TrimSpaces(alternatives).isEmpty())
        return token;
    if (!LevelAllows(divisor, random))
        return token;
    const QStringList pieces = SplitAlternatives(alternatives);
    const qsizetype k = DrawCandidate(pieces.size(), random);
    return Choice(token, k < pieces.size() ? QStringView(pieces.at(k)) : QStringView(token));
}

QString SpinTokens(const QStringList &tokens, qsizetype count, const SpinSettings &settings,
                   AlternativesSource &source, RandomSource &random)
{
    QString result;
    for (qsizetype i = 0; i < count; ++i) {
        const QString &token = tokens.at(i);
        if (IsCustomizableWord(token, settings.WordTest))
            result += ReplaceWord(token, source.Alternatives(token), settings, random);
        else
            result += token;
    }
    return result;
}

} // namespace

WordFileAlternatives::WordFileAlternatives(const WordStore &store)
    : m_store(store)
{
}

QString WordFileAlternatives::Alternatives(const QString &token)
{
    return m_store.ReadAlternatives(token);
}

CachedWordFileAlternatives::CachedWordFileAlternatives(const WordStore &store)
    : m_store(store)
{
}

QString CachedWordFileAlternatives::Alternatives(const QString &token)
{
    // Keyed like the file name, so words differing only in capitals read their file once.
    const QString key = token.toLower();
    auto it = m_cache.constFind(key);
    if (it == m_cache.constEnd()) {
        ++m_fileReads;
        it = m_cache.insert(key, m_store.ReadAlternatives(token));
    }
    return it.value();
}

const QStringList &CustomizationLevelNames()
{
    static const QStringList names{u"Maximum"_qs, u"Level 3"_qs, u"Level 2"_qs, u"Level 1"_qs, u"Minimum"_qs};
    return names;
}

QString ReplaceWord(const QString &token, const QString &alternatives, const SpinSettings &settings,
                    RandomSource &random)
{
    if (TrimSpaces(alternatives).isEmpty())
        return token;
    if (!IsCustomizableWord(token, settings.WordTest))
        return token;
    return ReplaceCustomizable(token, alternatives, Divisor(settings), random);
}

QString SpinTitle(const QStringList &titleTokens, const SpinSettings &settings,
                  AlternativesSource &source, RandomSource &random)
{
    return SpinTokens(titleTokens, std::max<qsizetype>(titleTokens.size() - 1, 0), settings, source,
                      random);
}

QString SpinContents(const QStringList &contentsTokens, const SpinSettings &settings,
                     AlternativesSource &source, RandomSource &random)
{
    return LfToCrLf(SpinTokens(contentsTokens, contentsTokens.size(), settings, source, random));
}

Spinner::Spinner(const ArticleTokens &article, const SpinSettings &settings,
                 AlternativesSource &source, RandomSource &random)
    : m_article(article)
    , m_settings(settings)
    , m_source(source)
    , m_random(random)
    , m_mersenne(dynamic_cast<MersenneRandomSource *>(&random))
{
}

namespace {

// Texts are copied in blocks of this many characters; plans and writers keep that much slack,
// so short texts (most words) cost one fixed-size copy.
constexpr qsizetype kCopyBlock = 16;

void CopyText(QChar *to, const QChar *from, qsizetype length)
{
    for (qsizetype done = 0; done < length; done += kCopyBlock)
        std::memcpy(to + done, from + done, kCopyBlock * sizeof(QChar));
}

// Collects a text from pieces into one growing buffer.
class TextWriter final
{
public:
    explicit TextWriter(qsizetype capacity)
        : m_text(std::max<qsizetype>(capacity, 64) + kCopyBlock, Qt::Uninitialized)
        , m_data(m_text.data())
    {
    }

    /// `from` must be readable for the length rounded up to whole blocks.
    void AppendPadded(const QChar *from, qsizetype length)
    {
        Reserve(length + kCopyBlock);
        CopyText(m_data + m_size, from, length);
        m_size += length;
    }

    void Append(const QString &text)
    {
        Reserve(text.size());
        std::copy_n(text.constData(), text.size(), m_data + m_size);
        m_size += text.size();
    }

    QString Take()
    {
        m_text.truncate(m_size);
        return std::move(m_text);
    }

private:
    void Reserve(qsizetype length)
    {
        if (m_size + length > m_text.size()) {
            m_text.resize(std::max(m_text.size() * 2, m_size + length));
            m_data = m_text.data();
        }
    }

    QString m_text;
    QChar *m_data;
    qsizetype m_size = 0;
};

// A segment while the plan is built: candidates and plain output, each with the unchanged
// tokens that follow appended.
struct SegmentDraft
{
    QStringList Choices;
    QString Output;
    qsizetype ReadAtSpin = -1;
};

} // namespace

Spinner::SpinPlan Spinner::Plan(const QStringList &tokens, qsizetype count, bool crLf)
{
    const bool fixed = m_source.KeepsTextsForRun();
    const auto output = [crLf](const QString &text) { return crLf ? LfToCrLf(text) : text; };

    QList<SegmentDraft> drafts(1); // leading unchanged tokens
    for (qsizetype i = 0; i < count; ++i) {
        const QString &token = tokens.at(i);
        if (IsCustomizableWord(token, m_settings.WordTest)) {
            if (!fixed) {
                drafts.append(SegmentDraft{{}, {}, i});
                drafts.append(SegmentDraft()); // the unchanged tokens after it
                continue;
            }
            const QString alternatives = m_source.Alternatives(token);
            if (!TrimSpaces(alternatives).isEmpty()) {
                SegmentDraft draft;
                for (const QString &piece : SplitAlternatives(alternatives))
                    draft.Choices.append(output(Choice(token, piece)));
                draft.Choices.append(output(Choice(token, token)));
                draft.Output = output(token);
                drafts.append(draft);
                continue;
            }
        }
        // A token that stays as it is joins every text of the segment before it.
        SegmentDraft &last = drafts.last();
        const QString text = output(token);
        last.Output += text;
        for (QString &choice : last.Choices)
            choice += text;
    }

    SpinPlan plan;
    plan.Source = tokens;
    plan.CrLf = crLf;
    const auto store = [&plan](const QString &text) {
        const TextSpan span{plan.Pool.size(), text.size()};
        plan.Pool += text;
        return span;
    };
    for (const SegmentDraft &draft : drafts) {
        if (draft.ReadAtSpin < 0 && draft.Choices.isEmpty() && draft.Output.isEmpty())
            continue;
        Segment segment;
        segment.ReadAtSpin = draft.ReadAtSpin;
        segment.Output = store(draft.Output);
        segment.FirstChoice = plan.Choices.size();
        for (const QString &choice : draft.Choices)
            plan.Choices.append(store(choice));
        segment.Candidates = draft.Choices.size();
        plan.Segments.append(segment);
    }
    plan.Pool += QString(kCopyBlock, QLatin1Char(' ')); // slack for the block copies
    return plan;
}

template<typename Random>
QString Spinner::Spin(const SpinPlan &plan, qsizetype &sizeHint, Random &random)
{
    const int divisor = Divisor(m_settings);
    const QChar *pool = plan.Pool.constData();
    const TextSpan *choices = plan.Choices.constData();
    TextWriter writer(sizeHint);
    for (const Segment &segment : plan.Segments) {
        if (segment.Candidates > 0) {
            if (LevelAllows(divisor, random)) {
                const qsizetype k = DrawCandidate(segment.Candidates - 1, random);
                const TextSpan &choice = choices[segment.FirstChoice + k];
                writer.AppendPadded(pool + choice.Offset, choice.Length);
                continue;
            }
        } else if (segment.ReadAtSpin >= 0) {
            const QString &token = plan.Source.at(segment.ReadAtSpin);
            const QString text =
                ReplaceCustomizable(token, m_source.Alternatives(token), divisor, random);
            writer.Append(plan.CrLf ? LfToCrLf(text) : text);
            continue;
        }
        writer.AppendPadded(pool + segment.Output.Offset, segment.Output.Length);
    }
    QString result = writer.Take();
    sizeHint = std::max(sizeHint, result.size() + result.size() / 8);
    return result;
}

QString Spinner::Spin(const SpinPlan &plan, qsizetype &sizeHint)
{
    return m_mersenne ? Spin(plan, sizeHint, *m_mersenne) : Spin(plan, sizeHint, m_random);
}

QString Spinner::SpinTitle()
{
    if (!m_titlePlan) {
        const QStringList &tokens = m_article.TitleTokens;
        m_titlePlan = Plan(tokens, std::max<qsizetype>(tokens.size() - 1, 0), false);
    }
    return Spin(*m_titlePlan, m_titleSizeHint);
}

QString Spinner::SpinContents()
{
    if (!m_contentsPlan) {
        const QStringList &tokens = m_article.ContentsTokens;
        m_contentsPlan = Plan(tokens, tokens.size(), true);
    }
    return Spin(*m_contentsPlan, m_contentsSizeHint);
}

} // namespace verbloom
