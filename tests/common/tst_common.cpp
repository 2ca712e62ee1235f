#include "common/IniFile.h"
#include "common/LineEnds.h"
#include "common/Numbers.h"
#include "common/ProgramFolder.h"
#include "common/TextFile.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>
#include <QtTest>

#include <unistd.h>

#include <cmath>

using namespace verbloom;

class TestCommon final : public QObject
{
    Q_OBJECT

private slots:
    void roundsHalvesToEven_data();
    void roundsHalvesToEven();
    void numericTest_data();
    void numericTest();
    void val_data();
    void val();
    void readsUtf8AndWindows1252_data();
    void readsUtf8AndWindows1252();
    void writesUtf8WithoutBomAtomically();
    void writeFailsWithoutTouchingOldFile();
    void readsMissingFileAsEmpty();
    void iniValues_data();
    void iniValues();
    void homeArgument();
    void lineEnds_data();
    void lineEnds();
};

void TestCommon::roundsHalvesToEven_data()
{
    QTest::addColumn<double>("value");
    QTest::addColumn<int>("expected"); // -99999 marks a refused conversion
    QTest::newRow("0.5") << 0.5 << 0;
    QTest::newRow("1.5") << 1.5 << 2;
    QTest::newRow("2.5") << 2.5 << 2;
    QTest::newRow("3.5") << 3.5 << 4;
    QTest::newRow("-0.5") << -0.5 << 0;
    QTest::newRow("-1.5") << -1.5 << -2;
    QTest::newRow("-2.5") << -2.5 << -2;
    QTest::newRow("2.4999") << 2.4999 << 2;
    QTest::newRow("2.5001") << 2.5001 << 3;
    QTest::newRow("max") << 32767.0 << 32767;
    QTest::newRow("max+0.4") << 32767.4 << 32767;
    QTest::newRow("max+0.5 rounds to even, out") << 32767.5 << -99999;
    QTest::newRow("min") << -32768.0 << -32768;
    QTest::newRow("min-0.5 rounds to even, in") << -32768.5 << -32768;
    QTest::newRow("min-0.6") << -32768.6 << -99999;
    QTest::newRow("huge") << 1e300 << -99999;
    QTest::newRow("nan") << std::nan("") << -99999;
}

void TestCommon::roundsHalvesToEven()
{
    QFETCH(double, value);
    QFETCH(int, expected);
    const std::optional<qint16> result = ToInt16(value);
    if (expected == -99999) {
        QVERIFY(!result.has_value());
    } else {
        QVERIFY(result.has_value());
        QCOMPARE(int(*result), expected);
    }
}

void TestCommon::numericTest_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<bool>("numeric");
    QTest::addColumn<double>("value");
    QTest::newRow("integer") << u"42"_qs << true << 42.0;
    QTest::newRow("blanks around") << u"  42 "_qs << true << 42.0;
    QTest::newRow("sign") << u"-3.5"_qs << true << -3.5;
    QTest::newRow("plus") << u"+7"_qs << true << 7.0;
    QTest::newRow("leading point") << u".5"_qs << true << 0.5;
    QTest::newRow("trailing point") << u"5."_qs << true << 5.0;
    QTest::newRow("exponent") << u"1e3"_qs << true << 1000.0;
    QTest::newRow("exponent sign") << u"2.5E-1"_qs << true << 0.25;
    QTest::newRow("empty") << QString() << false << 0.0;
    QTest::newRow("blanks only") << u"   "_qs << false << 0.0;
    QTest::newRow("point only") << u"."_qs << false << 0.0;
    QTest::newRow("sign only") << u"-"_qs << false << 0.0;
    QTest::newRow("letters") << u"abc"_qs << false << 0.0;
    QTest::newRow("trailing letter") << u"12a"_qs << false << 0.0;
    QTest::newRow("dangling exponent") << u"1e"_qs << false << 0.0;
    QTest::newRow("two points") << u"1.2.3"_qs << false << 0.0;
    QTest::newRow("inner blank") << u"1 2"_qs << false << 0.0;
}

void TestCommon::numericTest()
{
    QFETCH(QString, text);
    QFETCH(bool, numeric);
    QFETCH(double, value);
    QCOMPARE(IsNumeric(text), numeric);
    const std::optional<double> parsed = ParseNumber(text);
    QCOMPARE(parsed.has_value(), numeric);
    if (numeric)
        QCOMPARE(*parsed, value);
}

void TestCommon::val_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<double>("value");
    QTest::newRow("plain") << u"10"_qs << 10.0;
    QTest::newRow("leading number") << u"12abc"_qs << 12.0;
    QTest::newRow("inner blanks") << u" 1 2 3"_qs << 123.0;
    QTest::newRow("decimal") << u"2.5 links"_qs << 2.5;
    QTest::newRow("comma stops") << u"1,5"_qs << 1.0;
    QTest::newRow("nothing") << u"abc"_qs << 0.0;
    QTest::newRow("empty") << QString() << 0.0;
    QTest::newRow("negative") << u"-4"_qs << -4.0;
}

void TestCommon::val()
{
    QFETCH(QString, text);
    QFETCH(double, value);
    QCOMPARE(Val(text), value);
}

void TestCommon::readsUtf8AndWindows1252_data()
{
    QTest::addColumn<QByteArray>("bytes");
    QTest::addColumn<QString>("text");
    QTest::newRow("ascii") << QByteArray("plain") << u"plain"_qs;
    QTest::newRow("utf-8") << QByteArray("caf\xc3\xa9 \xe2\x80\x9cq\xe2\x80\x9d") << u"caf\u00e9 \u201cq\u201d"_qs;
    QTest::newRow("utf-8 bom dropped") << QByteArray("\xef\xbb\xbfx") << u"x"_qs;
    QTest::newRow("cp1252") << QByteArray("caf\xe9 \x93q\x94 \x80") << u"caf\u00e9 \u201cq\u201d \u20ac"_qs;
    QTest::newRow("crlf kept") << QByteArray("a\r\nb") << u"a\r\nb"_qs;
}

void TestCommon::readsUtf8AndWindows1252()
{
    QFETCH(QByteArray, bytes);
    QFETCH(QString, text);
    QTemporaryDir dir;
    const QString path = dir.filePath(u"f.txt"_qs);
    QFile file(path);
    QVERIFY(file.open(QIODevice::WriteOnly));
    file.write(bytes);
    file.close();
    QCOMPARE(ReadTextFile(path), text);
}

void TestCommon::writesUtf8WithoutBomAtomically()
{
    QTemporaryDir dir;
    const QString path = dir.filePath(u"out.txt"_qs);
    QVERIFY(WriteTextFile(path, u"caf\u00e9\r\n"_qs));
    QFile file(path);
    QVERIFY(file.open(QIODevice::ReadOnly));
    QCOMPARE(file.readAll(), QByteArray("caf\xc3\xa9\r\n"));
    QVERIFY(WriteTextFile(path, QString()));
    QCOMPARE(QFileInfo(path).size(), 0);
    // no temporary files left beside it
    QCOMPARE(QDir(dir.path()).entryList(QDir::Files), QStringList{u"out.txt"_qs});
}

void TestCommon::writeFailsWithoutTouchingOldFile()
{
    QTemporaryDir dir;
    QVERIFY(!WriteTextFile(dir.filePath(u"missing/sub/out.txt"_qs), u"x"_qs));
    QVERIFY(!WriteTextFile(QString(), u"x"_qs));
    QVERIFY(!WriteTextFile(dir.filePath(u"a\0b"_qs), u"x"_qs));
    const QString path = dir.filePath(u"keep.txt"_qs);
    QVERIFY(WriteTextFile(path, u"old"_qs));
    QVERIFY(QFile::setPermissions(dir.path(), QFile::ReadOwner | QFile::ExeOwner));
    if (::geteuid() != 0) { // root may write anywhere
        QVERIFY(!WriteTextFile(path, u"new"_qs));
        QCOMPARE(ReadTextFile(path), u"old"_qs);
    }
    QFile::setPermissions(dir.path(), QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
}

void TestCommon::readsMissingFileAsEmpty()
{
    QTemporaryDir dir;
    QString text = u"x"_qs;
    QVERIFY(!TryReadTextFile(dir.filePath(u"none"_qs), text));
    QCOMPARE(text, QString());
    QCOMPARE(ReadTextFile(dir.filePath(u"none"_qs)), QString());
    QCOMPARE(ReadTextFile(dir.path()), QString()); // a folder reads as nothing
}

void TestCommon::iniValues_data()
{
    QTest::addColumn<QString>("section");
    QTest::addColumn<QString>("key");
    QTest::addColumn<QString>("expected");
    QTest::newRow("plain") << u"URL"_qs << u"BANNER_URL"_qs << u"http://example.test/banner"_qs;
    QTest::newRow("case of names") << u"url"_qs << u"banner_url"_qs << u"http://example.test/banner"_qs;
    QTest::newRow("blanks trimmed") << u"COMPANY"_qs << u"CompanyName"_qs << u"Acme Ltd"_qs;
    QTest::newRow("quotes removed") << u"COMPANY"_qs << u"Quoted"_qs << u" in quotes "_qs;
    QTest::newRow("long value kept whole") << u"URL"_qs << u"Long"_qs << QString(100, u'x');
    QTest::newRow("missing key") << u"URL"_qs << u"Nope"_qs << QString();
    QTest::newRow("missing section") << u"NONE"_qs << u"BANNER_URL"_qs << QString();
    QTest::newRow("key of other section") << u"COMPANY"_qs << u"BANNER_URL"_qs << QString();
    QTest::newRow("comment ignored") << u"URL"_qs << u"Commented"_qs << QString();
    QTest::newRow("empty value") << u"URL"_qs << u"Empty"_qs << QString();
}

void TestCommon::iniValues()
{
    QFETCH(QString, section);
    QFETCH(QString, key);
    QFETCH(QString, expected);
    QTemporaryDir dir;
    const QString path = dir.filePath(u"SETTINGS.INI"_qs);
    const QString ini = u"; settings\r\n[URL]\r\nBANNER_URL=http://example.test/banner\r\n"
                        u";Commented=yes\r\nEmpty=\r\nLong="_qs
                        + QString(100, u'x')
                        + u"\r\n\r\n[ COMPANY ]\r\n  CompanyName   =   Acme Ltd  \r\nQuoted=\" in quotes \"\r\n"_qs;
    QVERIFY(WriteTextFile(path, ini));
    QCOMPARE(ReadIniValue(section, key, path), expected);
    QCOMPARE(ReadIniValue(section, key, dir.filePath(u"missing.ini"_qs)), QString());
}

void TestCommon::homeArgument()
{
    QCOMPARE(HomeFolderArgument({u"verbloom"_qs, u"--home"_qs, u"/tmp/x"_qs}), u"/tmp/x"_qs);
    QCOMPARE(HomeFolderArgument({u"verbloom"_qs, u"--home=/tmp/y"_qs}), u"/tmp/y"_qs);
    QCOMPARE(HomeFolderArgument({u"verbloom"_qs, u"--home"_qs}), QString());
    QCOMPARE(HomeFolderArgument({u"verbloom"_qs}), QString());
    QTemporaryDir dir;
    SetProgramFolder(dir.path() + u"/"_qs);
    QCOMPARE(ProgramPath(u"data"_qs), QDir::cleanPath(dir.path()) + u"/data"_qs);
}

void TestCommon::lineEnds_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<QString>("lfToCrLf");
    QTest::addColumn<QString>("normalized");
    QTest::newRow("none") << u"abc"_qs << u"abc"_qs << u"abc"_qs;
    QTest::newRow("lf") << u"a\nb\n"_qs << u"a\r\nb\r\n"_qs << u"a\r\nb\r\n"_qs;
    QTest::newRow("crlf stays one break") << u"a\r\nb"_qs << u"a\r\r\nb"_qs << u"a\r\nb"_qs;
    QTest::newRow("lone cr") << u"a\rb"_qs << u"a\rb"_qs << u"a\r\nb"_qs;
    QTest::newRow("lf cr is two breaks") << u"a\n\rb"_qs << u"a\r\n\rb"_qs << u"a\r\n\r\nb"_qs;
}

void TestCommon::lineEnds()
{
    QFETCH(QString, text);
    QFETCH(QString, lfToCrLf);
    QFETCH(QString, normalized);
    QCOMPARE(LfToCrLf(text), lfToCrLf);
    QCOMPARE(NormalizeToCrLf(text), normalized);
}

QTEST_GUILESS_MAIN(TestCommon)
#include "tst_common.moc"
