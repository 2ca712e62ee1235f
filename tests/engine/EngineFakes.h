#pragma once

#include "engine/RandomSource.h"
#include "engine/SpinGenerator.h"
#include "engine/ThesaurusLookup.h"

#include <QHash>
#include <QList>
#include <QStringList>

#include <functional>

namespace verbloom::test {

/// Returns the given draws in order; counts every draw (past the end it gives 0).
class ScriptedRandomSource final : public RandomSource
{
public:
    explicit ScriptedRandomSource(QList<double> draws = {}) : m_draws(std::move(draws)) {}
    double NextUniform() override { return m_draws.value(m_taken++, 0.0); }
    qsizetype Taken() const { return m_taken; }

private:
    QList<double> m_draws;
    qsizetype m_taken = 0;
};

/// Alternatives from a table; records which tokens were asked for.
class TableAlternatives final : public AlternativesSource
{
public:
    explicit TableAlternatives(QHash<QString, QString> table) : m_table(std::move(table)) {}
    QString Alternatives(const QString &token) override
    {
        Asked.append(token);
        return m_table.value(token);
    }
    QStringList Asked;

private:
    QHash<QString, QString> m_table;
};

/// A page source that serves texts by address and logs every call.
class FakePageSource final : public PageSource
{
public:
    QHash<QString, QString> Pages; ///< by the address navigated to; missing gives ""
    bool Completes = true;
    std::function<void()> OnWait;  ///< runs inside the wait, as pending events would
    QStringList Log;

    void Stop() override { Log.append(QStringLiteral("stop")); }
    void Navigate(const QString &url) override
    {
        Log.append(QStringLiteral("navigate ") + url);
        m_current = url;
    }
    bool WaitUntilComplete(int timeoutMs) override
    {
        Log.append(QStringLiteral("wait ") + QString::number(timeoutMs));
        if (OnWait)
            OnWait();
        return Completes;
    }
    QString PageText() override { return Pages.value(m_current); }

private:
    QString m_current;
};

/// Keeps every offer.
class RecordingPresenter final : public ConfirmMeaningPresenter
{
public:
    void Offer(const ConfirmOffer &offer) override { Offers.append(offer); }
    QList<ConfirmOffer> Offers;
};

/// CR LF joined lines, as a page source gives them.
inline QString PageLines(const QStringList &lines)
{
    return lines.join(QStringLiteral("\r\n"));
}

} // namespace verbloom::test
