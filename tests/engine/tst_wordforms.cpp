#include "engine/WordForms.h"

#include <QtTest>

using namespace verbloom;

class TestWordForms final : public QObject
{
    Q_OBJECT

private slots:
    void splitSuffix_data();
    void splitSuffix();
    void inflectAlternatives_data();
    void inflectAlternatives();
};

void TestWordForms::splitSuffix_data()
{
    QTest::addColumn<QString>("word");
    QTest::addColumn<QString>("stem");
    QTest::addColumn<QString>("suffix");
    QTest::newRow("Running") << u"Running"_qs << u"Runn"_qs << u"ing"_qs;
    QTest::newRow("walked") << u"walked"_qs << u"walk"_qs << u"ed"_qs;
    QTest::newRow("cars") << u"cars"_qs << u"car"_qs << u"s"_qs;
    QTest::newRow("Fast") << u"Fast"_qs << QString() << QString();
    QTest::newRow("ending alone") << u"ing"_qs << QString() << u"ing"_qs;
    // The ending is found lowered; the stem keeps the word's capitals.
    QTest::newRow("capital ending") << u"JumpING"_qs << u"Jump"_qs << u"ing"_qs;
}

void TestWordForms::splitSuffix()
{
    QFETCH(QString, word);
    QFETCH(QString, stem);
    QFETCH(QString, suffix);
    const StemAndSuffix result = SplitSuffix(word);
    QCOMPARE(result.Stem, stem);
    QCOMPARE(result.Suffix, suffix);
}

void TestWordForms::inflectAlternatives_data()
{
    QTest::addColumn<QString>("alternatives");
    QTest::addColumn<QString>("suffix");
    QTest::addColumn<QString>("expected");
    QTest::newRow("ed drops e") << u"bake, cook"_qs << u"ed"_qs << u"baked, cooked"_qs;
    QTest::newRow("ing drops e") << u"bake, cook"_qs << u"ing"_qs << u"baking, cooking"_qs;
    QTest::newRow("s y to ie") << u"party, feast"_qs << u"s"_qs << u"parties, feasts"_qs;
    QTest::newRow("day") << u"day"_qs << u"s"_qs << u"daies"_qs;
    QTest::newRow("phrase dropped") << u"run fast, sprint"_qs << u"ing"_qs << u"sprinting"_qs;
    QTest::newRow("lower case") << u"Happy, Glad"_qs << u"ed"_qs << u"happyed, gladed"_qs;
    QTest::newRow("double comma") << u"a,,b"_qs << u"ed"_qs << u"aed, ed, bed"_qs;
    QTest::newRow("trailing comma") << u"walk,"_qs << u"ed"_qs << u"walked, ed"_qs;
    QTest::newRow("only phrases") << u"go on, set off"_qs << u"ed"_qs << QString();
    // Each ending rule belongs to its own suffixes; blanks around a piece are trimmed.
    QTest::newRow("other suffix, trimmed") << u"  bake  ,try "_qs << u"er"_qs << u"bakeer, tryer"_qs;
    QTest::newRow("y kept for ed") << u"try"_qs << u"ed"_qs << u"tryed"_qs;
    QTest::newRow("e kept for s") << u"bake"_qs << u"s"_qs << u"bakes"_qs;
}

void TestWordForms::inflectAlternatives()
{
    QFETCH(QString, alternatives);
    QFETCH(QString, suffix);
    QFETCH(QString, expected);
    QCOMPARE(InflectAlternatives(alternatives, suffix), expected);
}

QTEST_GUILESS_MAIN(TestWordForms)
#include "tst_wordforms.moc"