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

namespace {

constexpr int kNone = -99999;

QByteArray ReadBytes(const QString &path)
{
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray("<unreadable>");
}

} // namespace

class TestCommon final : public QObject
{
    Q_OBJECT

private slots:
    void numbers_data();
    void numbers();
    void readsUtf8ElseWindows1252_data();
    void readsUtf8ElseWindows1252();
    void writesAtomically();
    void iniValues_data();
    void iniValues();
    void homeArgument();
    void lineEnds_data();
    void lineEnds();
};

void TestCommon::numbers_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<double>("number"); // ParseNumber; kNone: not numeric
    QTest::addColumn<int>("int16");     // TextToInt16; kNone: refused
    QTest::addColumn<double>("val");
    QTest::newRow("1.5") << u"1.5"_qs << 1.5 << 2 << 1.5;
    QTest::newRow("2.5") << u"2.5"_qs << 2.5 << 2 << 2.5;
    QTest::newRow("-1.5") << u"-1.5"_qs << -1.5 << -2 << -1.5;
    QTest::newRow("-2.5") << u"-2.5"_qs << -2.5 << -2 << -2.5;
    QTest::newRow("2.5001") << u"2.5001"_qs << 2.5001 << 3 << 2.5001;
    QTest::newRow("max+0.4, blanks") << u" \t32767.4 "_qs << 32767.4 << 32767 << 32767.4;
    QTest::newRow("max+0.5 rounds to even, out") << u"32767.5"_qs << 32767.5 << kNone << 32767.5;
    QTest::newRow("min-0.5 rounds to even") << u"-32768.5"_qs << -32768.5 << -32768 << -32768.5;
    QTest::newRow("min-0.6") << u"-32768.6"_qs << -32768.6 << kNone << -32768.6;
    QTest::newRow("huge") << u"1e300"_qs << 1e300 << kNone << 1e300;
    QTest::newRow("plus") << u"+7"_qs << 7.0 << 7 << 7.0;
    QTest::newRow("trailing point") << u"5."_qs << 5.0 << 5 << 5.0;
    QTest::newRow("exponent sign") << u"2.5E-1"_qs << 0.25 << 0 << 0.25;
    QTest::newRow("D exponent") << u"1d2"_qs << 100.0 << 100 << 100.0;
    QTest::newRow("blanks only") << u"   "_qs << double(kNone) << kNone << 0.0;
    QTest::newRow("point only") << u"."_qs << double(kNone) << kNone << 0.0;
    QTest::newRow("sign only") << u"-"_qs << double(kNone) << kNone << 0.0;
    QTest::newRow("trailing letters") << u"-12abc"_qs << double(kNone) << kNone << -12.0;
    QTest::newRow("dangling exponent") << u"1e"_qs << double(kNone) << kNone << 1.0;
    QTest::newRow("two points") << u"1.2.3"_qs << double(kNone) << kNone << 1.2;
    QTest::newRow("inner blanks") << u" 1 2\n3"_qs << double(kNone) << kNone << 123.0;
    QTest::newRow("comma") << u"1,5"_qs << double(kNone) << kNone << 1.0;
}

void TestCommon::numbers()
{
    QFETCH(QString, text);
    QFETCH(double, number);
    QFETCH(int, int16);
    QFETCH(double, val);
    QCOMPARE(IsNumeric(text), number != kNone);
    QCOMPARE(ParseNumber(text).value_or(kNone), number);
    const std::optional<qint16> converted = TextToInt16(text);
    QCOMPARE(converted ? int(*converted) : kNone, int16);
    QCOMPARE(Val(text), val);
    QVERIFY(!ToInt16(std::nan("")));
}

void TestCommon::readsUtf8ElseWindows1252_data()
{
    QTest::addColumn<QByteArray>("bytes");
    QTest::addColumn<QString>("text");
    QTest::newRow("utf-8") << QByteArray("caf\xc3\xa9 \xe2\x80\x9cq\xe2\x80\x9d")
                           << u"caf\u00e9 \u201cq\u201d"_qs;
    QTest::newRow("utf-8 bom dropped") << QByteArray("\xef\xbb\xbfx") << u"x"_qs;
    QTest::newRow("cp1252") << QByteArray("caf\xe9 \x93q\x94 \x80")
                            << u"caf\u00e9 \u201cq\u201d \u20ac"_qs;
    QTest::newRow("cut utf-8 sequence is cp1252") << QByteArray("caf\xc3") << u"caf\u00c3"_qs;
}

void TestCommon::readsUtf8ElseWindows1252()
{
    QFETCH(QByteArray, bytes);
    QFETCH(QString, text);
    QTemporaryDir dir;
    const QString path = dir.filePath(u"f.txt"_qs);
    QVERIFY(WriteBinaryFile(path, bytes));
    QCOMPARE(ReadTextFile(path), text);
}

void TestCommon::writesAtomically()
{
    QTemporaryDir dir;
    const QString path = dir.filePath(u"out.txt"_qs);
    const QString other = dir.filePath(u"other.txt"_qs);
    QVERIFY(WriteTextFile(path, u"old"_qs));
    QCOMPARE(::link(QFile::encodeName(path).constData(), QFile::encodeName(other).constData()), 0);
    QVERIFY(WriteTextFile(path, u"caf\u00e9\r\n"_qs));
    QCOMPARE(ReadBytes(path), QByteArray("caf\xc3\xa9\r\n")); // UTF-8 without BOM
    // Replaced whole, not rewritten in place: a second name of the old file still reads "old".
    QCOMPARE(ReadBytes(other), QByteArray("old"));
    QCOMPARE(QDir(dir.path()).entryList(QDir::Files), // no temporary file left
             (QStringList{u"other.txt"_qs, u"out.txt"_qs}));

    QVERIFY(!WriteTextFile(dir.filePath(u"missing/out.txt"_qs), u"x"_qs));
    QVERIFY(!WriteTextFile(QString(), u"x"_qs));
    QVERIFY(!WriteTextFile(dir.filePath(u"a\0b"_qs), u"x"_qs));
    QString text = u"x"_qs;
    QVERIFY(!TryReadTextFile(dir.filePath(u"none"_qs), text));
    QCOMPARE(text, QString());
    QCOMPARE(ReadTextFile(dir.path()), QString()); // a folder reads as nothing
}

void TestCommon::iniValues_data()
{
    QTest::addColumn<QString>("section");
    QTest::addColumn<QString>("key");
    QTest::addColumn<QString>("expected");
    const QString url = u"http://example.test/banner"_qs;
    QTest::newRow("plain") << u"URL"_qs << u"BANNER_URL"_qs << url;
    QTest::newRow("case of names") << u"url"_qs << u"banner_url"_qs << url;
    QTest::newRow("blanks trimmed") << u"COMPANY"_qs << u"CompanyName"_qs << u"Acme Ltd"_qs;
    QTest::newRow("quotes removed") << u"COMPANY"_qs << u"Quoted"_qs << u" in quotes "_qs;
    QTest::newRow("long value kept whole") << u"URL"_qs << u"Long"_qs << QString(100, u'x');
    QTest::newRow("missing section") << u"NONE"_qs << u"BANNER_URL"_qs << QString();
    QTest::newRow("key of other section") << u"COMPANY"_qs << u"BANNER_URL"_qs << QString();
    QTest::newRow("comment ignored") << u"URL"_qs << u"Commented"_qs << QString();
}

void TestCommon::iniValues()
{
    QFETCH(QString, section);
    QFETCH(QString, key);
    QFETCH(QString, expected);
    QTemporaryDir dir;
    const QString path = dir.filePath(u"SETTINGS.INI"_qs);
    QVERIFY(WriteTextFile(path, u"; settings\r\n[URL]\r\nBANNER_URL=http://example.test/banner\r\n"
                                u";Commented=yes\r\nLong="_qs + QString(100, u'x')
                                    + u"\r\n\r\n[ COMPANY ]\r\n  CompanyName   =   Acme Ltd  \r\n"
                                      u"Quoted=\" in quotes \"\r\n"_qs));
    QCOMPARE(ReadIniValue(section, key, path), expected);
    QCOMPARE(ReadIniValue(section, key, dir.filePath(u"missing.ini"_qs)), QString());
}

void TestCommon::homeArgument()
{
    QCOMPARE(HomeFolderArgument({u"verbloom"_qs, u"--home"_qs, u"/tmp/x"_qs}), u"/tmp/x"_qs);
    QCOMPARE(HomeFolderArgument({u"verbloom"_qs, u"--home=/tmp/y"_qs}), u"/tmp/y"_qs);
    QCOMPARE(HomeFolderArgument({u"verbloom"_qs, u"--home"_qs}), QString());
    QTemporaryDir dir;
    SetProgramFolder(dir.path() + u"/"_qs);
    QCOMPARE(ProgramPath(u"data"_qs), QDir::cleanPath(dir.path()) + u"/data"_qs);
}

void TestCommon::lineEnds_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<QString>("lfToCrLf");
    QTest::addColumn<QString>("normalized");
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
